#include "UI/Terminal/FindView.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

constexpr std::string_view TextLabel = " Find: ";
constexpr int HeadLines = 1; // the text
constexpr int TailLines = 1; // the count and the keys, where there is room
constexpr std::string_view Keys = "Enter opens   Esc leaves";

int roomFor(int height)
{
    return std::max(0, height - HeadLines - (height > HeadLines + TailLines ? TailLines : 0));
}

void drawFind(Grid& grid, int y, const Find& find)
{
    const int width = grid.width();
    const int end = grid.put(1, y, find.name, Style {.isBold = true}, {0, width - 1});
    const int valueStart = std::max(end + 2, width - columnsOf(find.value));
    grid.put(end + 2, y, find.panePath, Style {.isFaint = true}, {0, valueStart - 2});
    grid.put(valueStart, y, find.value, Style {.tint = Tint::Accent});
    if (!find.isLeaf)
        grid.put(width - 1, y, "›", Style {.isFaint = true});
}

} // namespace

/// Keeps the selected find in sight.
void FindView::settle(int height, const FindController& controller)
{
    const auto room = static_cast<std::size_t>(std::max(1, roomFor(height)));
    const std::size_t count = controller.finds().size();
    const std::size_t selected = controller.selected().value_or(0);
    _top = std::min(_top, count > room ? count - room : 0);
    _top = std::clamp(_top, selected < room ? 0 : selected - room + 1, selected);
}

void FindView::draw(Grid& grid, const FindController& controller)
{
    const int height = grid.height();
    settle(height, controller);
    const int start = grid.put(0, 0, TextLabel, Style {.isBold = true});
    _editor.draw(grid, 0, {start, grid.width()}, controller.text(), true);
    for (int line = 0; line < roomFor(height); ++line) {
        const std::size_t index = _top + static_cast<std::size_t>(line);
        if (index >= controller.finds().size())
            break;
        drawFind(grid, HeadLines + line, controller.finds()[index]);
        if (index == controller.selected())
            grid.reverse(HeadLines + line, {0, grid.width()});
    }
    if (roomFor(height) == height - HeadLines)
        return;
    const int end = grid.put(1, height - 1, controller.countText(), Style {});
    const int hint = grid.width() - columnsOf(Keys) - 1;
    if (hint > end + 1)
        grid.put(hint, height - 1, Keys, Style {.isFaint = true});
}

void FindView::handle(const KeyEvent& event, int height, FindController& controller)
{
    const std::ptrdiff_t page = std::max(1, roomFor(height));
    switch (event.key) {
    case Key::Escape:
        return controller.close();
    case Key::Enter:
        controller.choose();
        return;
    case Key::Up:
        return controller.moveSelection(-1);
    case Key::Down:
        return controller.moveSelection(1);
    case Key::PageUp:
        return controller.moveSelection(-page);
    case Key::PageDown:
        return controller.moveSelection(page);
    default: {
        std::string text = controller.text();
        if (_editor.handle(event, text, MaximumText) && text != controller.text())
            controller.setText(std::move(text));
    }
    }
}

void FindView::handle(const MouseEvent& event, int height, FindController& controller)
{
    if (event.action != MouseEvent::Action::Press)
        return controller.moveSelection(event.action == MouseEvent::Action::WheelUp ? -1 : 1);
    const int line = event.y - HeadLines;
    if (line < 0 || line >= roomFor(height))
        return;
    const std::size_t index = _top + static_cast<std::size_t>(line);
    if (index >= controller.finds().size())
        return;
    controller.select(index);
    controller.choose();
}

} // namespace spectrel
