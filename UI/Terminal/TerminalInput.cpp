#include "UI/Terminal/TerminalInput.h"

namespace spectrel {

namespace {

std::string characterName(char32_t character)
{
    if (character == U' ')
        return "Space";
    return character < 0x80 ? std::string(1, static_cast<char>(character)) : std::string();
}

} // namespace

std::string keyName(const KeyEvent& event)
{
    switch (event.key) {
    case Key::Character:
        return characterName(event.character);
    case Key::Up:
        return "Up";
    case Key::Down:
        return "Down";
    case Key::Left:
        return "Left";
    case Key::Right:
        return "Right";
    case Key::ShiftLeft:
        return "Shift-Left";
    case Key::ShiftRight:
        return "Shift-Right";
    case Key::PageUp:
        return "PgUp";
    case Key::PageDown:
        return "PgDn";
    case Key::Home:
        return "Home";
    case Key::End:
        return "End";
    case Key::Enter:
        return "Enter";
    case Key::Backspace:
        return "Backspace";
    case Key::Escape:
        return "Esc";
    case Key::Redraw:
        return "Control-L";
    default: // those of a line of text only
        return {};
    }
}

} // namespace spectrel
