#include "UI/TableView.h"

#include <algorithm>
#include <utility>

namespace spectrel {

TableView::TableView(ScreenToolkit& toolkit, TableSource& source)
    : _toolkit(toolkit)
    , _source(source)
{
}

void TableView::enqueue(CellRef cell)
{
    if (cell)
        _pool.push_back(std::move(cell));
}

CellRef TableView::dequeueReusableCell(std::string_view reuseIdentifier)
{
    const auto found = std::ranges::find_if(
        _pool, [reuseIdentifier](const CellRef& cell) { return cell->reuseIdentifier() == reuseIdentifier; });
    if (found == _pool.end())
        return nullptr;
    CellRef cell = std::move(*found);
    _pool.erase(found);
    return cell;
}

CellRef TableView::cellAtRow(std::size_t row) const
{
    if (row < _firstVisible || row - _firstVisible >= _visible.size())
        return nullptr;
    return _visible[row - _firstVisible];
}

/// Puts cells in sight for the rows from `first` to before `end`; `kept` holds those that have one already.
void TableView::fill(std::size_t first, std::size_t end, const std::vector<CellRef>& kept)
{
    _visible.clear();
    _firstVisible = first;
    for (std::size_t row = first; row < end; ++row) {
        CellRef cell = kept.empty() ? nullptr : kept[row - first];
        if (!cell) {
            cell = _source.cellForRow(*this, row);
            cell->setContentOffset(0);
        }
        _visible.push_back(std::move(cell));
    }
}

void TableView::setVisibleRows(std::size_t first, std::size_t count, const Rect& rowBounds)
{
    const std::size_t rows = numberOfRows();
    first = std::min(first, rows);
    const std::size_t end = first + std::min(count, rows - first);
    const bool hasNewBounds = std::exchange(_rowBounds, rowBounds) != rowBounds;
    _wantedRows = count;

    std::vector<CellRef> kept(end - first);
    for (std::size_t index = 0; index < _visible.size(); ++index) {
        const std::size_t row = _firstVisible + index;
        if (row >= first && row < end)
            kept[row - first] = std::move(_visible[index]);
        else
            enqueue(std::move(_visible[index]));
    }
    if (hasNewBounds) {
        for (std::size_t index = 0; index < kept.size(); ++index) {
            if (kept[index]) {
                kept[index]->bounds = rowBounds;
                _source.layOutCell(*kept[index], first + index);
            }
        }
    }
    fill(first, end, kept);
}

void TableView::reloadData()
{
    const std::size_t firstBefore = _firstVisible;
    std::vector<double> offsets;
    for (CellRef& cell : _visible) {
        offsets.push_back(cell->contentOffset());
        enqueue(std::move(cell));
    }
    _visible.clear();
    const std::size_t rows = numberOfRows();
    const std::size_t first = std::min(firstBefore, rows);
    fill(first, first + std::min(_wantedRows, rows - first), {});
    if (first == firstBefore) {
        for (std::size_t index = 0; index < std::min(offsets.size(), _visible.size()); ++index)
            _visible[index]->setContentOffset(offsets[index]);
    }
    _selectedRow.reset();
    _toolkit.screenDidChange(ScreenPart::Rows, Animation::None);
}

void TableView::selectRow(std::optional<std::size_t> row)
{
    if (row && *row >= numberOfRows())
        row.reset();
    if (row)
        _selectedRow = row;
    _source.didSelectRow(row);
}

void TableView::deselectRow(Animation animation)
{
    if (std::exchange(_selectedRow, std::nullopt))
        _toolkit.screenDidChange(ScreenPart::Rows, animation);
}

void TableView::showRow(std::size_t row)
{
    if (row >= numberOfRows())
        return;
    _selectedRow = row;
    _rowToShow = row;
    _toolkit.screenDidChange(ScreenPart::Rows, Animation::Animated);
}

} // namespace spectrel
