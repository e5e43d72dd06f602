#include "UI/Terminal/SaveView.h"

#include "UI/Terminal/PaneView.h"

#include <algorithm>
#include <string>
#include <utility>

namespace spectrel {

namespace {

constexpr std::string_view Title = "Save Snapshot";
constexpr std::string_view DescriptionLabel = " Description: ";
constexpr std::string_view CheckMark = "✓";
constexpr std::string_view SaveButton = "[Save]";
constexpr std::string_view CancelButton = "[Cancel]";
constexpr Span SavePlace {1, 7};
constexpr Span CancelPlace {9, 17};

bool holds(Span span, int x)
{
    return x >= span.left && x < span.right;
}

} // namespace

SaveView::Layout::Layout(int height)
    : buttons(height - 1)
{
    int next = 0;
    if (height >= 4)
        title = next++;
    if (height >= 2)
        description = next++;
    firstEntry = next;
    entries = std::max(0, buttons - firstEntry);
}

void SaveView::focusOn(Focus focus, SpectrelSaveViewController& controller)
{
    if (focus == Focus::Description)
        controller.beginEditing();
    else if (_focus == Focus::Description)
        controller.backgroundTouched();
    _focus = focus;
}

void SaveView::press(SpectrelSaveViewController& controller) const
{
    if (_focus == Focus::Save)
        controller.savePressed();
    else if (_focus == Focus::Cancel)
        controller.cancelPressed();
}

void SaveView::edit(const KeyEvent& event, SpectrelSaveViewController& controller)
{
    std::string text = controller.saveDescription()->text.value_or("");
    if (_editor.handle(event, text, MaximumDescription))
        controller.setDescriptionText(std::move(text));
}

void SaveView::scroll(std::ptrdiff_t by, int lines, const SpectrelSaveViewController& controller)
{
    const auto last = static_cast<std::ptrdiff_t>(controller.numberOfRows()) - lines;
    const auto top =
        std::clamp<std::ptrdiff_t>(static_cast<std::ptrdiff_t>(_top) + by, 0, std::max<std::ptrdiff_t>(last, 0));
    _top = static_cast<std::size_t>(top);
}

void SaveView::handle(const KeyEvent& event, int height, SpectrelSaveViewController& controller)
{
    const int lines = Layout(height).entries;
    const auto stepped = [this](int by) {
        constexpr int Places = 4;
        return static_cast<Focus>((static_cast<int>(_focus) + by + Places) % Places);
    };
    switch (event.key) {
    case Key::Escape:
        return controller.cancelPressed();
    case Key::Tab:
        return focusOn(stepped(1), controller);
    case Key::BackTab:
        return focusOn(stepped(-1), controller);
    case Key::Up:
    case Key::Down: {
        const int by = event.key == Key::Up ? -1 : 1;
        if (_focus == Focus::Entries && lines > 0 && controller.numberOfRows() > static_cast<std::size_t>(lines))
            return scroll(by, lines, controller);
        return focusOn(stepped(by), controller);
    }
    case Key::PageUp:
        return scroll(-std::max(lines, 1), lines, controller);
    case Key::PageDown:
        return scroll(std::max(lines, 1), lines, controller);
    case Key::Left:
    case Key::Right:
        if (_focus == Focus::Save || _focus == Focus::Cancel)
            _focus = event.key == Key::Left ? Focus::Save : Focus::Cancel;
        else if (_focus == Focus::Description)
            edit(event, controller);
        return;
    case Key::Enter:
        if (_focus == Focus::Description) {
            controller.textFieldShouldReturn(*controller.saveDescription());
            _focus = Focus::Save;
            return;
        }
        return press(controller);
    default:
        if (_focus == Focus::Description)
            edit(event, controller);
    }
}

void SaveView::handle(const MouseEvent& event, int height, SpectrelSaveViewController& controller)
{
    const Layout layout(height);
    if (event.action != MouseEvent::Action::Press)
        return scroll(event.action == MouseEvent::Action::WheelUp ? -1 : 1, layout.entries, controller);
    if (event.y == layout.buttons && (holds(SavePlace, event.x) || holds(CancelPlace, event.x))) {
        focusOn(holds(SavePlace, event.x) ? Focus::Save : Focus::Cancel, controller);
        return press(controller);
    }
    if (event.y == layout.description)
        return focusOn(Focus::Description, controller);
    const int line = event.y - layout.firstEntry;
    if (line >= 0 && line < layout.entries && _top + static_cast<std::size_t>(line) < controller.numberOfRows()) {
        _focus = Focus::Entries;
        return controller.saveContentTable()->selectRow(_top + static_cast<std::size_t>(line));
    }
    _focus = Focus::Entries;
    controller.backgroundTouched();
}

void SaveView::drawDescription(Grid& grid, int y, const SpectrelSaveViewController& controller) const
{
    const int start = grid.put(0, y, DescriptionLabel, Style {.isBold = true});
    _editor.draw(grid, y, {start, grid.width()}, controller.saveDescription()->text.value_or(""),
        controller.saveDescription()->isFirstResponder);
}

void SaveView::drawEntries(Grid& grid, const Layout& layout, SpectrelSaveViewController& controller) const
{
    TableView& table = *controller.saveContentTable();
    table.setVisibleRows(_top, static_cast<std::size_t>(layout.entries),
        {0, 0, grid.width() * TerminalMetrics::Column, TerminalMetrics::Line});
    for (int line = 0; line < layout.entries; ++line) {
        const CellRef cell = table.cellAtRow(_top + static_cast<std::size_t>(line));
        if (!cell)
            break;
        const int y = layout.firstEntry + line;
        if (cell->accessory == CellAccessory::Checkmark)
            grid.put(1, y, CheckMark, Style {.tint = Tint::Accent});
        grid.put(3, y, cell->textLabel.text, Style {.isBold = _focus == Focus::Entries});
    }
}

void SaveView::draw(Grid& grid, SpectrelSaveViewController& controller)
{
    const Layout layout(grid.height());
    scroll(0, layout.entries, controller); // the screen may have grown
    if (layout.title >= 0) {
        grid.fill(layout.title, {0, grid.width()}, Style {.isReversed = true});
        grid.put(1, layout.title, Title, Style {.isBold = true, .isReversed = true});
    }
    if (layout.description >= 0)
        drawDescription(grid, layout.description, controller);
    drawEntries(grid, layout, controller);
    grid.put(SavePlace.left, layout.buttons, SaveButton, Style {.isBold = true, .isReversed = _focus == Focus::Save});
    grid.put(CancelPlace.left, layout.buttons, CancelButton, Style {.isReversed = _focus == Focus::Cancel});
}

} // namespace spectrel
