#pragma once

#include "UI/FindController.h"
#include "UI/Terminal/Grid.h"
#include "UI/Terminal/LineEditor.h"
#include "UI/Terminal/TerminalInput.h"

#include <cstddef>

namespace spectrel {

/// The search on the terminal: the text, and the rows found with the pane of each.
class FindView {
public:
    /// Longer texts are not taken.
    static constexpr std::size_t MaximumText = 256; // bytes

    void draw(Grid& grid, const FindController& controller);
    /// `height` is the screen's.
    void handle(const KeyEvent& event, int height, FindController& controller);
    void handle(const MouseEvent& event, int height, FindController& controller);

private:
    void settle(int height, const FindController& controller);

    LineEditor _editor;
    std::size_t _top = 0; // the first find in sight
};

} // namespace spectrel
