#include "UI/Terminal/PaneView.h"

#include "UI/SpectrelCell.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

constexpr Style TitleStyle {.isBold = true, .isReversed = true};
constexpr Style NameStyle {.isBold = true};
constexpr Style FaintStyle {.isFaint = true};
constexpr std::string_view BackMark = "‹";
constexpr std::string_view DisclosureMark = "›";
constexpr std::string_view MoreMark = "…";
constexpr std::string_view SaveButton = "[Save]";
constexpr std::string_view HelpHint = "? help";
constexpr double SidewaysStep = 8; // columns
constexpr int WheelStep = 3; // rows

} // namespace

// ---- Cursor and scrolling

/// Finds the cursor's row again after a reload and keeps it, and as many rows as there are, in sight.
void PaneView::settle(SpectrelPaneController& pane, int rows)
{
    if (const auto shown = pane.tableView().takeRowToShow()) {
        _cursor = *shown;
        _cursorName.clear();
    }
    follow(pane);
    const std::size_t count = pane.numberOfRows();
    const auto room = static_cast<std::size_t>(std::max(rows, 1));
    _cursor = count == 0 ? 0 : std::min(_cursor, count - 1);
    _top = std::min(_top, count > room ? count - room : 0);
    _top = std::clamp(_top, _cursor < room ? 0 : _cursor - room + 1, _cursor);
    const NodeRef child = pane.childAtRow(_cursor);
    if (child && child->displayName() != _cursorName)
        _cursorName = child->displayName();
}

/// Moves the cursor with its row when rows came or went above it; the row stays on its line of the screen.
void PaneView::follow(SpectrelPaneController& pane)
{
    const NodeRef here = pane.childAtRow(_cursor);
    if (_cursorName.empty() || (here && here->displayName() == _cursorName))
        return;
    for (std::size_t row = 0; row < pane.numberOfRows(); ++row) {
        if (pane.childAtRow(row)->displayName() == _cursorName) {
            const std::size_t line = _cursor - std::min(_top, _cursor);
            _cursor = row;
            _top = row - std::min(line, row);
            return;
        }
    }
}

std::optional<std::size_t> PaneView::cursorRow(int height)
{
    const auto pane = _pane.lock();
    if (!pane)
        return std::nullopt;
    settle(*pane, Layout(height).rows);
    return _cursor < pane->numberOfRows() ? std::optional(_cursor) : std::nullopt;
}

void PaneView::moveTo(SpectrelPaneController& pane, std::size_t row, int rows)
{
    _cursor = row;
    _cursorName.clear();
    settle(pane, rows);
}

void PaneView::move(SpectrelPaneController& pane, std::ptrdiff_t by, int rows)
{
    const auto last = static_cast<std::ptrdiff_t>(pane.numberOfRows()) - 1;
    const auto row =
        std::clamp<std::ptrdiff_t>(static_cast<std::ptrdiff_t>(_cursor) + by, 0, std::max<std::ptrdiff_t>(last, 0));
    moveTo(pane, static_cast<std::size_t>(row), rows);
}

/// Moves the rows under the window; the cursor stays in sight.
void PaneView::scroll(SpectrelPaneController& pane, std::ptrdiff_t by, int rows)
{
    const auto count = static_cast<std::ptrdiff_t>(pane.numberOfRows());
    const std::ptrdiff_t top = std::clamp<std::ptrdiff_t>(
        static_cast<std::ptrdiff_t>(_top) + by, 0, std::max<std::ptrdiff_t>(count - rows, 0));
    _top = static_cast<std::size_t>(top);
    const auto cursor =
        std::clamp<std::ptrdiff_t>(static_cast<std::ptrdiff_t>(_cursor), top, top + std::max(rows, 1) - 1);
    moveTo(pane, static_cast<std::size_t>(cursor), rows);
}

/// Scrolls the content of the cursor's row; false when it stayed where it was.
bool PaneView::scrollSideways(SpectrelPaneController& pane, double columns) const
{
    SpectrelCell* cell = pane.cellAtRow(_cursor);
    return cell && cell->accessory == CellAccessory::None && cell->view
        && cell->view->scrollBy(columns * TerminalMetrics::Column);
}

// ---- Input

void PaneView::perform(KeyAction action, int height, NavigationController& navigation)
{
    const auto pane = _pane.lock();
    if (!pane)
        return;
    const int rows = Layout(height).rows;
    settle(*pane, rows);
    const std::ptrdiff_t page = std::max(rows - 1, 1);
    switch (action) {
    case KeyAction::RowUp:
        return move(*pane, -1, rows);
    case KeyAction::RowDown:
        return move(*pane, 1, rows);
    case KeyAction::PageUp:
        return move(*pane, -page, rows);
    case KeyAction::PageDown:
        return move(*pane, page, rows);
    case KeyAction::FirstRow:
        return moveTo(*pane, 0, rows);
    case KeyAction::LastRow:
        return moveTo(*pane, pane->numberOfRows(), rows);
    case KeyAction::Open:
        return pane->tableView().selectRow(_cursor);
    case KeyAction::Back:
        return navigation.popViewController(Animation::Animated);
    default:
        return performSideways(action, *pane, navigation);
    }
}

void PaneView::performSideways(KeyAction action, SpectrelPaneController& pane, NavigationController& navigation) const
{
    const NodeRef child = pane.childAtRow(_cursor);
    switch (action) {
    case KeyAction::Forward:
        if (child && !child->childNodes())
            scrollSideways(pane, SidewaysStep);
        else
            pane.tableView().selectRow(_cursor);
        return;
    case KeyAction::Backward: // back to the value's beginning first, where Forward has moved it
        if (!scrollSideways(pane, -SidewaysStep))
            navigation.popViewController(Animation::Animated);
        return;
    case KeyAction::ScrollRight:
        scrollSideways(pane, SidewaysStep);
        return;
    case KeyAction::ScrollLeft:
        scrollSideways(pane, -SidewaysStep);
        return;
    default:
        return;
    }
}

void PaneView::handle(const MouseEvent& event, int height, NavigationController& navigation)
{
    const auto pane = _pane.lock();
    if (!pane)
        return;
    const Layout layout(height);
    settle(*pane, layout.rows);
    if (event.action != MouseEvent::Action::Press)
        return scroll(*pane, event.action == MouseEvent::Action::WheelUp ? -WheelStep : WheelStep, layout.rows);
    if (layout.hasTitle && event.y == 0)
        return navigation.popViewController(Animation::Animated);
    if (layout.hasToolbar && event.y == height - 1) {
        if (event.x >= _saveButton.left && event.x < _saveButton.right)
            pane->pressSaveButton();
        return;
    }
    const int line = event.y - layout.firstRow();
    if (line < 0 || line >= layout.rows)
        return;
    const std::size_t row = _top + static_cast<std::size_t>(line);
    if (row >= pane->numberOfRows())
        return;
    moveTo(*pane, row, layout.rows);
    pane->tableView().selectRow(_cursor);
}

// ---- Drawing

void PaneView::draw(Grid& grid, const Surroundings& around)
{
    const auto pane = _pane.lock();
    if (!pane)
        return;
    const Layout layout(around.height);
    settle(*pane, layout.rows);
    pane->tableView().setVisibleRows(_top, static_cast<std::size_t>(std::max(layout.rows, 0)),
        {0, 0, grid.width() * TerminalMetrics::Column, TerminalMetrics::Line});
    if (layout.hasTitle)
        drawTitle(grid, *pane, around.isRoot);
    for (int line = 0; line < layout.rows; ++line) {
        const std::size_t row = _top + static_cast<std::size_t>(line);
        const SpectrelCell* cell = pane->cellAtRow(row);
        if (!cell)
            break;
        drawRow(grid, layout.firstRow() + line, *cell);
        if (row == _cursor)
            grid.reverse(layout.firstRow() + line, {0, grid.width()});
    }
    if (layout.hasToolbar)
        drawToolbar(grid, *pane, around);
}

void PaneView::drawTitle(Grid& grid, const SpectrelPaneController& pane, bool isRoot) const
{
    grid.fill(0, {0, grid.width()}, TitleStyle);
    const int start = isRoot ? 1 : grid.put(0, 0, BackMark, TitleStyle) + 1;
    const int end = grid.put(start, 0, pane.title(), TitleStyle);
    const std::string_view right = isRoot ? HelpHint : std::string_view(pane.path());
    const int columns = columnsOf(right);
    if (end + 2 + columns + 1 <= grid.width())
        grid.put(grid.width() - columns - 1, 0, right, Style {.isReversed = true});
}

void PaneView::drawRow(Grid& grid, int y, const SpectrelCell& cell) const
{
    const int width = grid.width();
    const auto place = [](double points) { return TerminalMetrics::columns(points); };
    if (cell.accessory == CellAccessory::DisclosureIndicator) {
        grid.put(place(cell.key.frame.x), y, cell.key.text, NameStyle, {0, width - 2});
        grid.put(width - 1, y, DisclosureMark, FaintStyle);
        return;
    }
    const int offset = cell.view ? place(cell.view->contentOffset) : 0;
    grid.put(place(cell.key.frame.x) - offset, y, cell.key.text, NameStyle);
    if (!cell.value || !cell.view)
        return;
    const int valueStart = place(cell.value->frame.x) - offset;
    const int valueEnd = grid.put(valueStart, y, cell.value->text, Style {.tint = Tint::Accent});
    if (offset > 0)
        grid.put(0, y, MoreMark, FaintStyle);
    if (valueEnd > width || (valueStart >= width && !cell.value->text.empty()))
        grid.put(width - 1, y, MoreMark, FaintStyle);
}

void PaneView::drawToolbar(Grid& grid, const SpectrelPaneController& pane, const Surroundings& around)
{
    const int y = around.height - 1;
    _saveButton = {};
    int right = grid.width();
    const auto& items = pane.toolbarItems();
    const auto hasKind = [](ToolbarItem::Kind kind) {
        return [kind](const ToolbarItem& item) { return item.kind == kind; };
    };
    if (std::ranges::any_of(items, hasKind(ToolbarItem::Kind::SaveButton))) {
        const int columns = columnsOf(SaveButton);
        _saveButton = {std::max(0, right - columns - 1), std::max(0, right - 1)};
        grid.put(_saveButton.left, y, SaveButton, Style {.isBold = true});
        right = _saveButton.left - 1;
    }
    int x = 1;
    bool isFirst = true;
    for (const ToolbarItem& item : items) {
        if (item.kind == ToolbarItem::Kind::LoadingIndicator && item.isSpinning) {
            grid.put(x, y, std::string_view(&around.spinner, 1), Style {.tint = Tint::Accent}, {0, right});
            x += 2;
        } else if (item.kind == ToolbarItem::Kind::Label) {
            const Style style = isFirst ? Style {} : Style {.tint = Tint::Warning};
            x = grid.put(x, y, item.text, style, {0, right}) + 2;
            isFirst = false;
        }
    }
    grid.put(x, y, around.notice, Style {.tint = Tint::Warning}, {0, right});
}

} // namespace spectrel
