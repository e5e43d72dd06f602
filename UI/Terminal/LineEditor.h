#pragma once

#include "UI/Terminal/Grid.h"
#include "UI/Terminal/TerminalInput.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace spectrel {

/// The cursor in a line of text that is edited, and what the keys do there. The text itself is the controller's.
class LineEditor {
public:
    /// Edits the text or moves the cursor, glyph by glyph; false when the key is none of the editor's. What would make
    /// the text longer than `maximum` bytes is not taken.
    bool handle(const KeyEvent& event, std::string& text, std::size_t maximum);
    /// Draws the text; the cursor, when it is shown, stays in sight.
    void draw(Grid& grid, int y, Span place, std::string_view text, bool showsCursor) const;

private:
    std::size_t cursorIn(std::string_view text) const;
    void erase(std::string& text, std::size_t from, std::size_t end);

    std::size_t _cursor = std::string::npos; // bytes before it; beyond the text: at its end
};

} // namespace spectrel
