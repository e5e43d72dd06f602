#include "UI/Terminal/TerminalScreen.h"

#include "UI/SpectrelApp.h"
#include "UI/Terminal/Box.h"

#include <algorithm>
#include <string>
#include <utility>
#include <variant>

namespace spectrel {

namespace {

constexpr std::string_view SpinnerFrames = "|/-\\";

constexpr int SmallestWithPlayback = 4; // lines

} // namespace

TerminalScreen::TerminalScreen(Terminal terminal)
    : _terminal(std::move(terminal))
{
}

Size TerminalScreen::sizeOfText(std::string_view text, const Font&) const
{
    return {columnsOf(text) * TerminalMetrics::Column, TerminalMetrics::Line};
}

Size TerminalScreen::mainScreenSize() const
{
    return {_grid.width() * TerminalMetrics::Column, _grid.height() * TerminalMetrics::Line};
}

void TerminalScreen::screenDidChange(ScreenPart part, Animation)
{
    if (part == ScreenPart::Modal) {
        _saveView = SaveView();
        if (application() && application()->saveViewController())
            application()
                ->saveViewController()
                ->beginEditing(); // a keyboard is at hand: typing goes into the description
    }
    _terminal.needsDisplay();
}

void TerminalScreen::showAlert(const Alert& alert)
{
    _alerts.push_back(alert);
    _terminal.needsDisplay();
}

Outcome TerminalScreen::copyToClipboard(const std::string& text)
{
    if (text.size() > MaximumCopy)
        return Failure {std::to_string(text.size()) + " bytes are too many for a terminal"};
    _terminal.copy(text);
    return Done {};
}

void TerminalScreen::resize(int width, int height)
{
    _grid.resize(width, height);
    _terminal.needsDisplay();
}

/// Null where none is to be seen.
SpectrelApp* TerminalScreen::shownApplication() const
{
    SpectrelApp* app = application();
    return app && app->window() && app->window()->isKeyAndVisible ? app : nullptr;
}

// ---- Input

/// Brings the views in line with the stack of panes; the one of the top pane.
PaneView* TerminalScreen::topView(SpectrelApp& app)
{
    if (!app.navController())
        return nullptr;
    const auto& panes = app.navController()->viewControllers();
    std::size_t kept = 0;
    while (kept < std::min(panes.size(), _panes.size()) && _panes[kept].shows(panes[kept]))
        ++kept;
    _panes.erase(_panes.begin() + static_cast<std::ptrdiff_t>(kept), _panes.end());
    for (std::size_t index = kept; index < panes.size(); ++index)
        _panes.emplace_back(panes[index]);
    return &_panes.back();
}

/// The alert or the help takes what comes while it is in sight.
bool TerminalScreen::coverTakes(const KeyEvent& event)
{
    if (!_alerts.empty()) {
        _alerts.pop_front();
        return true;
    }
    if (!_help.isOpen())
        return false;
    _help.handle(event, _grid);
    return true;
}

bool TerminalScreen::coverTakes(const MouseEvent& event)
{
    if (!_alerts.empty()) {
        if (event.action == MouseEvent::Action::Press) // a turn of the wheel presses nothing
            _alerts.pop_front();
        return true;
    }
    if (!_help.isOpen())
        return false;
    _help.handle(event, _grid);
    return true;
}

void TerminalScreen::handleOnPane(SpectrelApp& app, PaneView& view, const KeyEvent& event)
{
    const std::string key = keyName(event);
    if (app.playback() && app.playback()->press(key, KeyTaker::Terminal))
        return;
    if (const auto action = actionOf(key, KeyTaker::Terminal, KeyScope::Browsing))
        perform(*action, app, view);
}

/// What concerns the whole screen; the rest is the pane's.
void TerminalScreen::perform(KeyAction action, SpectrelApp& app, PaneView& view)
{
    SpectrelPaneController& pane = *app.navController()->topViewController();
    switch (action) {
    case KeyAction::Quit:
        return _terminal.quit();
    case KeyAction::Help:
        return _help.open(app.playback() != nullptr);
    case KeyAction::Save:
        return pane.pressSaveButton();
    case KeyAction::Find:
        return app.find()->open();
    case KeyAction::FindNext:
        app.find()->chooseNext();
        return;
    case KeyAction::FindPrevious:
        app.find()->choosePrevious();
        return;
    case KeyAction::CopyRow:
        if (const auto row = view.cursorRow(paneHeight(app)))
            app.copying()->copyRow(pane, *row);
        return;
    case KeyAction::CopyPane:
        return app.copying()->copyPane(pane);
    default:
        return view.perform(action, paneHeight(app), *app.navController());
    }
}

void TerminalScreen::handleOnPane(SpectrelApp& app, PaneView& view, const MouseEvent& event)
{
    if (event.y < paneHeight(app))
        return view.handle(event, paneHeight(app), *app.navController());
    if (event.action == MouseEvent::Action::Press && app.playback())
        _playbackView.press(event.x, *app.playback());
}

template <typename Event> void TerminalScreen::dispatch(const Event& event)
{
    if (coverTakes(event))
        return;
    SpectrelApp* app = shownApplication();
    PaneView* view = app ? topView(*app) : nullptr;
    if (!view)
        return;
    app->copying()->clearMessage();
    if (app->saveViewController())
        _saveView.handle(event, _grid.height(), *app->saveViewController());
    else if (app->find()->isOpen())
        _findView.handle(event, _grid.height(), *app->find());
    else
        handleOnPane(*app, *view, event);
}

void TerminalScreen::handle(const InputEvent& event)
{
    std::visit([this](const auto& given) { dispatch(given); }, event);
    _terminal.needsDisplay();
}

// ---- Drawing

/// The lines of the pane; the one below them is the playback's, where there is one.
int TerminalScreen::paneHeight(const SpectrelApp& app) const
{
    const bool showsPlayback = app.playback() && _grid.height() >= SmallestWithPlayback;
    return _grid.height() - (showsPlayback ? 1 : 0);
}

void TerminalScreen::drawPane(SpectrelApp& app, PaneView& view)
{
    PaneView::Surroundings around {
        paneHeight(app), _panes.size() == 1, SpinnerFrames[_spinner % SpinnerFrames.size()], app.copying()->message()};
    if (app.playback() && around.notice.empty())
        around.notice = app.playback()->notice();
    view.draw(_grid, around);
    if (around.height < _grid.height())
        _playbackView.draw(_grid, around.height, *app.playback());
}

const Grid& TerminalScreen::draw()
{
    _grid.clear();
    SpectrelApp* app = shownApplication();
    PaneView* view = app ? topView(*app) : nullptr;
    if (!view)
        return _grid;
    if (app->saveViewController())
        _saveView.draw(_grid, *app->saveViewController());
    else if (app->find()->isOpen())
        _findView.draw(_grid, *app->find());
    else
        drawPane(*app, *view);
    if (!_alerts.empty()) {
        const Alert& alert = _alerts.front();
        const std::vector<std::string> lines {alert.title, "", alert.message, "", "[" + alert.button + "]"};
        drawBox(_grid, brokenForBox(lines, _grid.width()), 0);
    } else if (_help.isOpen()) {
        _help.draw(_grid);
    }
    return _grid;
}

bool TerminalScreen::isAnimating() const
{
    const SpectrelApp* app = shownApplication();
    if (!app || !app->navController() || app->saveViewController() || app->find()->isOpen() || paneHeight(*app) < 3)
        return false;
    return std::ranges::any_of(app->navController()->topViewController()->toolbarItems(),
        [](const ToolbarItem& item) { return item.kind == ToolbarItem::Kind::LoadingIndicator && item.isSpinning; });
}

void TerminalScreen::advanceSpinner()
{
    ++_spinner;
    _terminal.needsDisplay();
}

} // namespace spectrel
