#pragma once

#include "UI/Terminal/Grid.h"
#include "UI/Terminal/KeyDecoder.h"
#include "UI/Terminal/TerminalGuard.h"
#include "Values/Result.h"

#include <functional>
#include <memory>
#include <string>

namespace spectrel {

/// The real terminal on standard input and output: shows a grid, changed cells only, and reads keys and the mouse.
///
/// Colours appear only where the terminal has them and never when NO_COLOR is set. On terminals without UTF-8 all
/// else than ASCII shows as its nearest likeness or as '?'. Destroying it gives the terminal back.
class CursesTerminal {
public:
    /// Takes the terminal; fails when there is none or it is of an unknown kind. Sets the locale's
    /// character type from the environment, and nothing else of the locale.
    static Result<std::unique_ptr<CursesTerminal>> open();
    ~CursesTerminal();
    CursesTerminal(const CursesTerminal&) = delete;
    CursesTerminal& operator=(const CursesTerminal&) = delete;

    int width() const;
    int height() const;
    /// Takes on the terminal's present size.
    void updateSize();
    void show(const Grid& grid);
    /// Puts the text on the terminal's clipboard (OSC 52), where the terminal allows that; none answers whether it did.
    /// Inside tmux the sequence is for tmux, which keeps a buffer and hands it on when its set-clipboard is "on"; the
    /// passthrough to the terminal outside is not used, as it is off by default and would leave tmux's buffers out.
    void copy(const std::string& text) const;
    /// Shows every cell again at the next `show`, whatever the terminal was thought to hold.
    void forgetShown();
    /// Hands out what can be read now, without waiting; false when the terminal is gone.
    bool read(const std::function<void(const InputEvent&)>& handler);
    /// Leaves the terminal to others until `resume`.
    void suspend();
    void resume();

private:
    CursesTerminal() = default;
    void startScreen();
    void rememberLeavingSequence() const;
    void showCell(int x, int y, const GridCell& cell) const;
    void readMouse(const std::function<void(const InputEvent&)>& handler) const;

    std::unique_ptr<TerminalGuard> _guard;
    struct Screen;
    std::unique_ptr<Screen> _screen;
    Grid _shown;
    bool _hasShown = false;
    bool _hasColours = false;
    bool _isUTF8 = false;
    KeyDecoder _decoder;
};

} // namespace spectrel
