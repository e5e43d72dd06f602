#pragma once

#include "UI/ScreenToolkit.h"

#include <cstddef>
#include <deque>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace spectrel {

/// One line of text in a row.
struct Label {
    std::string text = {};
    Font font = {};
    Rect frame = {}; // within the row's content
};

enum class CellStyle { Default };
enum class CellAccessory { None, DisclosureIndicator, Checkmark };

/// A row of a table.
class TableCell {
public:
    TableCell(CellStyle style, std::string reuseIdentifier)
        : _style(style)
        , _reuseIdentifier(std::move(reuseIdentifier))
    {
    }
    virtual ~TableCell() = default;
    TableCell(const TableCell&) = delete;
    TableCell& operator=(const TableCell&) = delete;

    const std::string& reuseIdentifier() const
    {
        return _reuseIdentifier;
    }
    CellStyle style() const
    {
        return _style;
    }

    /// The row's standard layout: the content fills the row.
    virtual void layoutSubviews()
    {
        contentBounds = bounds;
    }
    /// How far the row's content is moved to the left, pt; always 0 in a row whose content does not scroll. A row that
    /// comes into sight begins at 0; what stays in sight keeps its offset through a reload, whichever cell it gets.
    virtual double contentOffset() const
    {
        return 0;
    }
    /// As far as the content goes.
    virtual void setContentOffset(double) { }

    CellAccessory accessory = CellAccessory::None;
    Label textLabel; // the standard label; rows with labels of their own leave it empty
    Rect bounds; // of the row, set by the table
    Rect contentBounds;

private:
    friend class TableView;
    CellStyle _style;
    std::string _reuseIdentifier;
};

using CellRef = std::shared_ptr<TableCell>;
class TableView;

/// Where a table's rows come from, and who hears of taps. One section.
class TableSource {
public:
    virtual ~TableSource() = default;
    virtual std::size_t numberOfRows() const = 0;
    /// The row, from the table's pool where it has one; `row` is below `numberOfRows`.
    virtual CellRef cellForRow(TableView& table, std::size_t row) = 0;
    /// Lays the row out again after its bounds have changed.
    virtual void layOutCell(TableCell& cell, std::size_t row) = 0;
    /// No row: nothing that could be selected was tapped.
    virtual void didSelectRow(std::optional<std::size_t> row) = 0;
};

/// A table that keeps cells only for the rows in sight and uses them again.
///
/// Cells return to the pool in row order and are taken from it in the order of their return. On a reload all rows in
/// sight go back first, then they are filled anew from the first to the last.
class TableView {
public:
    TableView(ScreenToolkit& toolkit, TableSource& source);

    /// The rows that the screen has room for: `count` rows from row `first`, each with the bounds. Rows that leave
    /// the sight return to the pool before those that come into it are taken.
    void setVisibleRows(std::size_t first, std::size_t count, const Rect& rowBounds);
    void reloadData();
    /// A cell with that identifier from the pool, or null.
    CellRef dequeueReusableCell(std::string_view reuseIdentifier);
    /// The cell of a row in sight; null for any other row.
    CellRef cellAtRow(std::size_t row) const;
    std::size_t numberOfRows() const
    {
        return _source.numberOfRows();
    }
    /// The bounds of every row.
    const Rect& rowBounds() const
    {
        return _rowBounds;
    }

    /// A tap on the row.
    void selectRow(std::optional<std::size_t> row);
    void deselectRow(Animation animation);
    /// Marks the row as selected without a tap and has it brought into sight; nothing when there is no such row.
    void showRow(std::size_t row);
    /// The row that the front end still has to bring into sight; asked once.
    std::optional<std::size_t> takeRowToShow()
    {
        return std::exchange(_rowToShow, std::nullopt);
    }
    std::optional<std::size_t> selectedRow() const
    {
        return _selectedRow;
    }

private:
    void enqueue(CellRef cell);
    void fill(std::size_t first, std::size_t end, const std::vector<CellRef>& kept);

    ScreenToolkit& _toolkit;
    TableSource& _source;
    Rect _rowBounds;
    std::size_t _firstVisible = 0;
    std::size_t _wantedRows = 0; // room on the screen
    std::vector<CellRef> _visible; // of the rows from `_firstVisible`
    std::deque<CellRef> _pool; // the first returned is at the front
    std::optional<std::size_t> _selectedRow;
    std::optional<std::size_t> _rowToShow;
};

} // namespace spectrel
