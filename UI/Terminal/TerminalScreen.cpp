#include "UI/Terminal/TerminalScreen.h"

#include "UI/SpectrelApp.h"

#include <algorithm>
#include <string>
#include <utility>
#include <variant>

namespace spectrel {

namespace {

constexpr std::string_view SpinnerFrames = "|/-\\";

const std::vector<std::string>& helpLines()
{
    static const std::vector<std::string> lines {
        "Keys",
        "",
        "Up Down  j k      move",
        "PgUp PgDn         move a page",
        "Home End          first, last row",
        "Enter Right       open",
        "Backspace Left    back (also Esc)",
        "Right  h l        scroll a long value",
        "s                 save a snapshot, if allowed",
        "Control-L         draw again",
        "q                 quit",
    };
    return lines;
}

SpectrelApp* shownApplication()
{
    SpectrelApp* app = SpectrelApp::sharedApplication();
    return app && app->window() && app->window()->isKeyAndVisible ? app : nullptr;
}

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
        SpectrelApp* app = SpectrelApp::sharedApplication();
        if (app && app->saveViewController())
            app->saveViewController()->beginEditing(); // a keyboard is at hand: typing goes into the description
    }
    _terminal.needsDisplay();
}

void TerminalScreen::showAlert(const Alert& alert)
{
    _alerts.push_back(alert);
    _terminal.needsDisplay();
}

bool TerminalScreen::copyToClipboard(const std::string& text, std::string& reason)
{
    if (text.size() > MaximumCopy) {
        reason = std::to_string(text.size()) + " bytes are too many for a terminal";
        return false;
    }
    _terminal.copy(text);
    return true;
}

void TerminalScreen::resize(int width, int height)
{
    _grid.resize(width, height);
    _terminal.needsDisplay();
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

bool TerminalScreen::closesOverlay()
{
    if (!_alerts.empty()) {
        _alerts.pop_front();
        return true;
    }
    return std::exchange(_showsHelp, false);
}

bool TerminalScreen::handleGlobalKey(SpectrelApp& app, const KeyEvent& event)
{
    if (event.key != Key::Character)
        return false;
    switch (event.character) {
    case U'q':
        _terminal.quit();
        return true;
    case U'?':
        _showsHelp = true;
        return true;
    case U's':
        PaneView::pressSaveButton(*app.navController()->topViewController());
        return true;
    default:
        return false;
    }
}

template <typename Event> void TerminalScreen::dispatch(const Event& event)
{
    if (closesOverlay())
        return;
    SpectrelApp* app = shownApplication();
    PaneView* view = app ? topView(*app) : nullptr;
    if (!view)
        return;
    if (app->saveViewController())
        _saveView.handle(event, _grid.height(), *app->saveViewController());
    else if (!handleGlobalKey(*app, event))
        view->handle(event, _grid.height(), *app->navController());
}

void TerminalScreen::handle(const InputEvent& event)
{
    if (const auto* mouse = std::get_if<MouseEvent>(&event);
        mouse && mouse->action != MouseEvent::Action::Press && (_showsHelp || !_alerts.empty()))
        return; // a turn of the wheel presses nothing
    std::visit([this](const auto& given) { dispatch(given); }, event);
    _terminal.needsDisplay();
}

// ---- Drawing

const Grid& TerminalScreen::draw()
{
    _grid.clear();
    SpectrelApp* app = shownApplication();
    PaneView* view = app ? topView(*app) : nullptr;
    if (!view)
        return _grid;
    if (app->saveViewController())
        _saveView.draw(_grid, *app->saveViewController());
    else
        view->draw(_grid, _panes.size() == 1, SpinnerFrames[_spinner % SpinnerFrames.size()]);
    if (!_alerts.empty()) {
        const Alert& alert = _alerts.front();
        drawBox({alert.title, "", alert.message, "", "[" + alert.button + "]"}, 0);
    } else if (_showsHelp) {
        drawBox(helpLines(), 0);
    }
    return _grid;
}

/// A framed box in the middle, over what is there.
void TerminalScreen::drawBox(const std::vector<std::string>& lines, std::size_t boldLine)
{
    int inner = 0;
    for (const std::string& line : lines)
        inner = std::max(inner, columnsOf(line));
    const int width = std::min(inner + 4, _grid.width());
    const int height = static_cast<int>(lines.size()) + 2;
    const int left = (_grid.width() - width) / 2;
    const int top = std::max(0, (_grid.height() - height) / 2);
    std::string bar;
    for (int column = 0; column < width - 2; ++column)
        bar += "─";
    _grid.put(left, top, "┌" + bar + "┐", Style {});
    for (std::size_t index = 0; index < lines.size(); ++index) {
        const int y = top + 1 + static_cast<int>(index);
        _grid.fill(y, {left, left + width}, Style {});
        _grid.put(left, y, "│", Style {});
        _grid.put(left + 2, y, lines[index], Style {.isBold = index == boldLine}, {left, left + width - 1});
        _grid.put(left + width - 1, y, "│", Style {});
    }
    _grid.put(left, top + height - 1, "└" + bar + "┘", Style {});
}

bool TerminalScreen::isAnimating() const
{
    const SpectrelApp* app = shownApplication();
    if (!app || !app->navController() || app->saveViewController() || _grid.height() < 3)
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
