#pragma once

#include "UI/Terminal/Grid.h"
#include "UI/Terminal/TerminalInput.h"

#include <cstddef>
#include <string>
#include <vector>

namespace spectrel {

/// The list of the keys, in a box that scrolls where it does not fit.
class HelpView {
public:
    bool isOpen() const
    {
        return _isOpen;
    }
    /// `plays`: with the keys of a recording's time line.
    void open(bool plays);
    void draw(Grid& grid) const;
    /// Scrolls where there is more to see; any other key closes it. `screen` is what it was drawn on.
    void handle(const KeyEvent& event, const Grid& screen);
    void handle(const MouseEvent& event, const Grid& screen);

private:
    bool scroll(std::ptrdiff_t by, const Grid& screen);

    bool _isOpen = false;
    std::vector<std::string> _lines;
    std::size_t _top = 0; // the first line in sight
};

} // namespace spectrel
