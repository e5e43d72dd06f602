#include "UI/Terminal/HelpView.h"

#include "UI/AboutText.h"
#include "UI/KeyTable.h"
#include "UI/Terminal/Box.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr std::size_t KeysWidth = 18; // columns of the keys, before what they do

void appendKeys(KeyScope scope, std::vector<std::string>& lines)
{
    for (const KeyLine& line : keyTable(scope)) {
        std::string keys(line.keys);
        keys.resize(KeysWidth, ' ');
        lines.push_back(keys.append(line.help));
    }
}

} // namespace

void HelpView::open(bool plays)
{
    _isOpen = true;
    _top = 0;
    _lines = {"Keys", ""};
    if (plays) {
        appendKeys(KeyScope::Playing, _lines);
        _lines.emplace_back();
    }
    appendKeys(KeyScope::Browsing, _lines);
    const AboutText about = AboutText::text();
    _lines.insert(_lines.end(), {"", about.name + " " + about.version, about.summary});
}

void HelpView::draw(Grid& grid) const
{
    const std::size_t room = boxRoom(grid.height());
    const auto lines = brokenForBox(_lines, grid.width());
    drawBox(grid, lines, std::min(_top, lines.size() > room ? lines.size() - room : 0));
}

/// False when it does not move.
bool HelpView::scroll(std::ptrdiff_t by, const Grid& screen)
{
    const auto room = static_cast<std::ptrdiff_t>(boxRoom(screen.height()));
    const auto count = static_cast<std::ptrdiff_t>(brokenForBox(_lines, screen.width()).size());
    const auto last = std::max<std::ptrdiff_t>(0, count - room);
    _top = static_cast<std::size_t>(
        std::clamp<std::ptrdiff_t>(std::min(static_cast<std::ptrdiff_t>(_top), last) + by, 0, last));
    return last > 0;
}

void HelpView::handle(const KeyEvent& event, const Grid& screen)
{
    const auto page = static_cast<std::ptrdiff_t>(boxRoom(screen.height()));
    std::ptrdiff_t by = 0;
    if (event.key == Key::Down || event == KeyEvent {Key::Character, U'j'})
        by = 1;
    else if (event.key == Key::Up || event == KeyEvent {Key::Character, U'k'})
        by = -1;
    else if (event.key == Key::PageDown || event == KeyEvent {Key::Character, U' '})
        by = page;
    else if (event.key == Key::PageUp)
        by = -page;
    if (by == 0 || !scroll(by, screen))
        _isOpen = false;
}

void HelpView::handle(const MouseEvent& event, const Grid& screen)
{
    if (event.action == MouseEvent::Action::Press)
        _isOpen = false;
    else // a turn of the wheel presses nothing
        scroll(event.action == MouseEvent::Action::WheelUp ? -1 : 1, screen);
}

} // namespace spectrel
