#pragma once

#include "UI/SpectrelSaveViewController.h"
#include "UI/Terminal/Grid.h"
#include "UI/Terminal/LineEditor.h"
#include "UI/Terminal/TerminalInput.h"

#include <cstddef>

namespace spectrel {

/// The save screen on the terminal: the description, the entries with their check marks, Save and Cancel.
class SaveView {
public:
    /// Longer descriptions are not taken.
    static constexpr std::size_t MaximumDescription = 1024; // bytes

    void draw(Grid& grid, SpectrelSaveViewController& controller);
    /// `height` is the screen's.
    void handle(const KeyEvent& event, int height, SpectrelSaveViewController& controller);
    void handle(const MouseEvent& event, int height, SpectrelSaveViewController& controller);

private:
    enum class Focus { Description, Entries, Save, Cancel };

    /// Which lines hold what; the smallest screens have only the buttons.
    struct Layout {
        explicit Layout(int height);
        int title = -1; // -1: not shown
        int description = -1;
        int firstEntry = 0;
        int entries = 0; // lines
        int buttons = 0;
    };

    void focusOn(Focus focus, SpectrelSaveViewController& controller);
    void press(SpectrelSaveViewController& controller) const;
    void edit(const KeyEvent& event, SpectrelSaveViewController& controller);
    void scroll(std::ptrdiff_t by, int lines, const SpectrelSaveViewController& controller);
    void drawEntries(Grid& grid, const Layout& layout, SpectrelSaveViewController& controller) const;
    void drawDescription(Grid& grid, int y, const SpectrelSaveViewController& controller) const;

    Focus _focus = Focus::Description;
    LineEditor _editor;
    std::size_t _top = 0; // the first entry in sight
};

} // namespace spectrel
