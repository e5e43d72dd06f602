#pragma once

#include <string>
#include <variant>

namespace spectrel {

enum class Key {
    Character, // a printable one, in `character`
    Up,
    Down,
    Left,
    Right,
    ShiftLeft,
    ShiftRight,
    PageUp,
    PageDown,
    Home, // also Control-A
    End, // also Control-E
    Enter,
    Backspace,
    Delete,
    Escape,
    Tab,
    BackTab,
    ClearLine, // Control-U
    EraseWord, // Control-W
    Redraw, // Control-L
};

struct KeyEvent {
    Key key = Key::Character;
    char32_t character = 0;
    friend bool operator==(const KeyEvent&, const KeyEvent&) = default;
};

/// The key's name in the key table; empty for a key without one.
std::string keyName(const KeyEvent& event);

struct MouseEvent {
    enum class Action { Press, WheelUp, WheelDown };
    Action action = Action::Press;
    int x = 0; // column
    int y = 0; // line
    friend bool operator==(const MouseEvent&, const MouseEvent&) = default;
};

using InputEvent = std::variant<KeyEvent, MouseEvent>;

} // namespace spectrel
