#pragma once

#include "Platform/ScreenToolkit.h"
#include "UI/Terminal/Grid.h"
#include "UI/Terminal/PaneView.h"
#include "UI/Terminal/SaveView.h"
#include "UI/Terminal/TerminalInput.h"

#include <deque>
#include <functional>
#include <vector>

namespace spectrel {

class SpectrelApp;

/// Everything of the terminal front end but the terminal: draws the shared application's screens into a grid and
/// hands input to the controllers. An alert covers the help, the help the save screen, and that the panes.
class TerminalScreen final : public ScreenToolkit {
public:
    /// `needsDisplay` is called whenever something may have to be drawn again; `quit` when the user wants to leave.
    TerminalScreen(std::function<void()> needsDisplay, std::function<void()> quit);

    // For the controllers.
    Size sizeOfText(std::string_view text, const Font& font) const override;
    Size mainScreenSize() const override;
    void screenDidChange(ScreenPart part, Animation animation) override;
    void showAlert(const Alert& alert) override;

    // For the terminal.
    void resize(int width, int height);
    void handle(const InputEvent& event);
    const Grid& draw();
    /// A loading indicator is in sight and spins.
    bool isAnimating() const;
    void advanceSpinner();

private:
    PaneView* topView(SpectrelApp& app);
    template <typename Event> void dispatch(const Event& event);
    bool closesOverlay();
    bool handleGlobalKey(SpectrelApp& app, const KeyEvent& event);
    bool handleGlobalKey(SpectrelApp&, const MouseEvent&)
    {
        return false;
    }
    void drawBox(const std::vector<std::string>& lines, std::size_t boldLine);

    std::function<void()> _needsDisplay;
    std::function<void()> _quit;
    Grid _grid;
    std::vector<PaneView> _panes; // beside the stack of panes, bottom first
    SaveView _saveView;
    std::deque<Alert> _alerts;
    bool _showsHelp = false;
    std::size_t _spinner = 0;
};

} // namespace spectrel
