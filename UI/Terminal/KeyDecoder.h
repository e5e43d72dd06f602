#pragma once

#include "UI/Terminal/TerminalInput.h"

#include <functional>
#include <optional>

namespace spectrel {

/// What one read from the terminal brought, in the terminal library's terms.
struct RawKey {
    bool isFunctionKey = false; // `code` is one of the library's KEY_ codes, otherwise a character
    unsigned code = 0;
};

/// Makes events of what the terminal sends. An escape sequence that the terminal library does not know is swallowed
/// whole, so that its letters are never taken for keys; Escape and any other key are two keys, however fast they come.
class KeyDecoder {
public:
    using Handler = std::function<void(const KeyEvent&)>;

    /// Hands out the events that the key completes.
    void feed(RawKey raw, const Handler& handler);
    /// Nothing more is there to read: an Escape that came last was the key itself.
    void flush(const Handler& handler);

    /// The mouse event of the library's button state, if it is one of ours; `x` is the column, `y` the line.
    static std::optional<MouseEvent> mouse(unsigned long buttons, int x, int y);

private:
    enum class State { Plain, Escaped, Sequence };
    State _state = State::Plain;
};

} // namespace spectrel
