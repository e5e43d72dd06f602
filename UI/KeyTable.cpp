#include "UI/KeyTable.h"

#include <algorithm>
#include <cstddef>

namespace spectrel {

namespace {

using enum KeyAction;

const std::vector<KeyLine> BrowsingKeys {
    {"Up Down  j k", "move", {{RowUp, "Up k", "Up"}, {RowDown, "Down j", "Down"}}},
    {"PgUp PgDn", "move a page", {{PageUp, "PgUp", "PgUp"}, {PageDown, "PgDn", "PgDown"}}},
    {"Home End", "first, last row", {{FirstRow, "Home", "Home"}, {LastRow, "End", "End"}}},
    {"Enter Right", "open", {{Open, "Enter", "Return Enter Space"}, {Forward, "Right", "Right"}}},
    {"Backspace Left", "back (also Esc)", {{Back, "Backspace Esc", "Backspace Esc Back"}, {Backward, "Left", "Left"}}},
    {"Right  h l", "scroll a long value", {{ScrollRight, "l Shift-Right", ""}, {ScrollLeft, "h Shift-Left", ""}}},
    {"/", "find a name or value here and below", {{Find, "/", "Ctrl+F"}}},
    {"n N", "next, previous find", {{FindNext, "n", "F3 Ctrl+G"}, {FindPrevious, "N", "Shift+F3 Ctrl+Shift+G"}}},
    {"y Y", "copy the value, the whole pane",
        {{CopyRow, "y", ""}, {CopyPane, "Y", ""}, {Copy, "", "Ctrl+C Ctrl+Ins F16"}}},
    {"s", "save a snapshot, if allowed", {{Save, "s", "Ctrl+S"}}},
    {"Control-L", "draw again", {{Redraw, "Control-L", ""}}},
    {"?", "this list", {{Help, "?", ""}}},
    {"q", "quit", {{Quit, "q", "Ctrl+Q"}}},
};

const std::vector<KeyLine> PlayingKeys {
    {"Space", "play, pause", {{PlayOrPause, "Space", "Space"}}},
    {". ,", "next, previous message", {{NextMessage, ".", "."}, {PreviousMessage, ",", ","}}},
    {"] [", "next, previous tick (2 s)", {{NextTick, "]", "]"}, {PreviousTick, "[", "["}}},
    {"> <", "10 s on, back", {{SeekForward, ">", ">"}, {SeekBackward, "<", "<"}}},
    {"0 ... 9  $", "to so many tenths, to the end",
        {{SeekToTenth, "0 1 2 3 4 5 6 7 8 9", "0 1 2 3 4 5 6 7 8 9"}, {SeekToEnd, "$", "$"}}},
    // The equals sign is the plus sign's key without Shift.
    {"+ -", "faster, slower", {{Faster, "+ =", "+ ="}, {Slower, "-", "-"}}},
};

} // namespace

const std::vector<KeyLine>& keyTable(KeyScope scope)
{
    return scope == KeyScope::Playing ? PlayingKeys : BrowsingKeys;
}

std::vector<std::string_view> keysIn(std::string_view list)
{
    std::vector<std::string_view> keys;
    while (!list.empty()) {
        const std::size_t length = std::min(list.find(' '), list.size());
        if (length > 0)
            keys.push_back(list.substr(0, length));
        list.remove_prefix(std::min(length + 1, list.size()));
    }
    return keys;
}

std::optional<KeyAction> actionOf(std::string_view key, KeyTaker taker, KeyScope scope)
{
    for (const KeyLine& line : keyTable(scope)) {
        for (const KeyBinding& binding : line.bindings) {
            if (std::ranges::count(keysIn(taker == KeyTaker::Terminal ? binding.terminal : binding.window), key) > 0)
                return binding.action;
        }
    }
    return std::nullopt;
}

std::vector<std::string_view> windowKeys(KeyAction action)
{
    for (const KeyScope scope : {KeyScope::Browsing, KeyScope::Playing}) {
        for (const KeyLine& line : keyTable(scope)) {
            const auto binding = std::ranges::find(line.bindings, action, &KeyBinding::action);
            if (binding != line.bindings.end())
                return keysIn(binding->window);
        }
    }
    return {};
}

} // namespace spectrel
