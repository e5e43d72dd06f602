#pragma once

#include "UI/KeyTable.h"
#include "UI/ScreenToolkit.h"
#include "UI/Terminal/FindView.h"
#include "UI/Terminal/Grid.h"
#include "UI/Terminal/HelpView.h"
#include "UI/Terminal/PaneView.h"
#include "UI/Terminal/PlaybackView.h"
#include "UI/Terminal/SaveView.h"
#include "UI/Terminal/TerminalInput.h"

#include <cstddef>
#include <deque>
#include <functional>
#include <string>
#include <vector>

namespace spectrel {

/// Everything of the terminal front end but the terminal: draws the application's screens into a grid and
/// hands input to the controllers. An alert covers the help, the help the save screen or the search, and those the
/// panes.
class TerminalScreen final : public ScreenToolkit {
public:
    /// The most that is copied: longer texts do not pass through every terminal.
    static constexpr std::size_t MaximumCopy = 74'994; // bytes; 100,000 characters on their way

    /// What the screens ask of the terminal's side.
    struct Terminal {
        std::function<void()> needsDisplay; // something may have to be drawn again
        std::function<void()> quit; // the user wants to leave
        std::function<void(const std::string&)> copy; // to the terminal's clipboard
    };
    explicit TerminalScreen(Terminal terminal);

    // For the controllers.
    Size sizeOfText(std::string_view text, const Font& font) const override;
    Size mainScreenSize() const override;
    void screenDidChange(ScreenPart part, Animation animation) override;
    void showAlert(const Alert& alert) override;
    Outcome copyToClipboard(const std::string& text) override;

    // For the terminal.
    void resize(int width, int height);
    void handle(const InputEvent& event);
    const Grid& draw();
    /// A loading indicator is in sight and spins.
    bool isAnimating() const;
    void advanceSpinner();

private:
    SpectrelApp* shownApplication() const;
    PaneView* topView(SpectrelApp& app);
    template <typename Event> void dispatch(const Event& event);
    bool coverTakes(const KeyEvent& event);
    bool coverTakes(const MouseEvent& event);
    void handleOnPane(SpectrelApp& app, PaneView& view, const KeyEvent& event);
    void handleOnPane(SpectrelApp& app, PaneView& view, const MouseEvent& event);
    void perform(KeyAction action, SpectrelApp& app, PaneView& view);
    int paneHeight(const SpectrelApp& app) const;
    void drawPane(SpectrelApp& app, PaneView& view);

    Terminal _terminal;
    Grid _grid;
    std::vector<PaneView> _panes; // beside the stack of panes, bottom first
    SaveView _saveView;
    FindView _findView;
    PlaybackView _playbackView;
    HelpView _help;
    std::deque<Alert> _alerts;
    std::size_t _spinner = 0;
};

} // namespace spectrel
