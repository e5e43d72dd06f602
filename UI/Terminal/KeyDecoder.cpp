#include "UI/Terminal/KeyDecoder.h"

#include <array>
#include <ncurses.h>
#include <utility>

namespace spectrel {

namespace {

constexpr unsigned EscapeCharacter = 0x1B;

constexpr std::array FunctionKeys {
    std::pair(static_cast<unsigned>(KEY_UP), Key::Up),
    std::pair(static_cast<unsigned>(KEY_DOWN), Key::Down),
    std::pair(static_cast<unsigned>(KEY_LEFT), Key::Left),
    std::pair(static_cast<unsigned>(KEY_RIGHT), Key::Right),
    std::pair(static_cast<unsigned>(KEY_SLEFT), Key::ShiftLeft),
    std::pair(static_cast<unsigned>(KEY_SRIGHT), Key::ShiftRight),
    std::pair(static_cast<unsigned>(KEY_PPAGE), Key::PageUp),
    std::pair(static_cast<unsigned>(KEY_NPAGE), Key::PageDown),
    std::pair(static_cast<unsigned>(KEY_HOME), Key::Home),
    std::pair(static_cast<unsigned>(KEY_END), Key::End),
    std::pair(static_cast<unsigned>(KEY_ENTER), Key::Enter),
    std::pair(static_cast<unsigned>(KEY_BACKSPACE), Key::Backspace),
    std::pair(static_cast<unsigned>(KEY_DC), Key::Delete),
    std::pair(static_cast<unsigned>(KEY_BTAB), Key::BackTab),
};

constexpr std::array ControlCharacters {
    std::pair(0x01U, Key::Home),
    std::pair(0x05U, Key::End),
    std::pair(0x08U, Key::Backspace),
    std::pair(0x09U, Key::Tab),
    std::pair(0x0AU, Key::Enter),
    std::pair(0x0CU, Key::Redraw),
    std::pair(0x0DU, Key::Enter),
    std::pair(0x15U, Key::ClearLine),
    std::pair(0x17U, Key::EraseWord),
    std::pair(0x7FU, Key::Backspace),
};

template <std::size_t Count>
std::optional<KeyEvent> lookUp(const std::array<std::pair<unsigned, Key>, Count>& table, unsigned code)
{
    for (const auto& [known, key] : table) {
        if (known == code)
            return KeyEvent {key};
    }
    return std::nullopt;
}

} // namespace

void KeyDecoder::feed(RawKey raw, const Handler& handler)
{
    const bool startsSequence = !raw.isFunctionKey && (raw.code == U'[' || raw.code == U'O');
    if (_state == State::Escaped && startsSequence) {
        _state = State::Sequence;
        return;
    }
    if (_state == State::Sequence && !raw.isFunctionKey) {
        if (raw.code >= 0x40)
            _state = State::Plain;
        return;
    }
    flush(handler);
    if (!raw.isFunctionKey && raw.code == EscapeCharacter) {
        _state = State::Escaped;
        return;
    }
    const bool isCharacter = !raw.isFunctionKey && raw.code >= 0x20 && raw.code != 0x7F;
    const auto event = isCharacter ? KeyEvent {Key::Character, raw.code}
        : raw.isFunctionKey        ? lookUp(FunctionKeys, raw.code)
                                   : lookUp(ControlCharacters, raw.code);
    if (event)
        handler(*event);
}

void KeyDecoder::flush(const Handler& handler)
{
    if (std::exchange(_state, State::Plain) == State::Escaped)
        handler(KeyEvent {Key::Escape});
}

std::optional<MouseEvent> KeyDecoder::mouse(unsigned long buttons, int x, int y)
{
    using Action = MouseEvent::Action;
    if (buttons & BUTTON4_PRESSED)
        return MouseEvent {Action::WheelUp, x, y};
    if (buttons & BUTTON5_PRESSED)
        return MouseEvent {Action::WheelDown, x, y};
    if (buttons & (BUTTON1_PRESSED | BUTTON1_CLICKED))
        return MouseEvent {Action::Press, x, y};
    return std::nullopt;
}

} // namespace spectrel
