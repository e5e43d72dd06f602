#include "UI/Quick/QuickScreen.h"

#include "UI/AboutText.h"
#include "UI/NavigationController.h"
#include "UI/Quick/QuickText.h"
#include "UI/SpectrelApp.h"

#include <QClipboard>
#include <QFontMetricsF>
#include <QGuiApplication>

#include <algorithm>
#include <utility>

namespace spectrel {

QuickScreen::QuickScreen(std::function<void()> quit)
    : _quit(std::move(quit))
{
}

Size QuickScreen::sizeOfText(std::string_view text, const Font& font) const
{
    const QFontMetricsF metrics(shownFont(font));
    return {metrics.horizontalAdvance(shownText(text)), metrics.height()};
}

Size QuickScreen::mainScreenSize() const
{
    return _size;
}

// ---- What the controllers tell

template <typename Member> void QuickScreen::forEachPane(Member member)
{
    const auto panes = _panes; // a pane may come or go meanwhile
    for (PaneModel* pane : panes)
        (pane->*member)();
}

void QuickScreen::screenDidChange(ScreenPart part, Animation animation)
{
    switch (part) {
    case ScreenPart::Window:
        emit windowShownChanged();
        emit _playback.changed();
        return adoptPanes(Animation::None);
    case ScreenPart::Navigation:
        return adoptPanes(animation);
    case ScreenPart::Title:
        return forEachPane(&PaneModel::titleDidChange);
    case ScreenPart::Rows:
        return forEachPane(&PaneModel::rowsDidChange);
    case ScreenPart::Toolbar:
        return forEachPane(&PaneModel::toolbarDidChange);
    case ScreenPart::Modal:
        return adoptSaveScreen();
    case ScreenPart::Text:
        if (_saveScreen)
            _saveScreen->textDidChange();
        return;
    case ScreenPart::Find:
        return _find.findsDidChange();
    case ScreenPart::Playback:
        emit _playback.changed();
        emit noticeChanged();
        return;
    case ScreenPart::Notice:
        emit noticeChanged();
        return;
    }
}

/// Brings the models in line with the stack of panes.
void QuickScreen::adoptPanes(Animation animation)
{
    const SpectrelApp* app = application();
    if (!_isReady || !app || !app->navController())
        return;
    const auto& panes = app->navController()->viewControllers();
    std::size_t kept = 0;
    while (kept < std::min(panes.size(), _panes.size()) && _panes[kept]->pane() == panes[kept])
        ++kept;
    const bool isAnimated = animation == Animation::Animated;
    if (kept < _panes.size()) {
        _panes.resize(kept); // their pages end them
        emit popped(static_cast<int>(kept), isAnimated);
    }
    for (std::size_t index = kept; index < panes.size(); ++index) {
        _panes.push_back(new PaneModel(panes[index], index == 0, this));
        emit pushed(_panes.back(), isAnimated);
    }
}

void QuickScreen::adoptSaveScreen()
{
    const SpectrelApp* app = application();
    SpectrelSaveViewController* shown = app ? app->saveViewController() : nullptr;
    if (_saveScreen && _saveScreen->shows(shown))
        return;
    if (_saveScreen)
        _saveScreen->controllerDidClose(); // the screen ends it when it has slid away
    _saveScreen = shown ? new SaveModel(*shown, this) : nullptr;
    emit saveScreenChanged();
}

void QuickScreen::showAlert(const Alert& alert)
{
    _alerts.push_back(alert);
    emit alertChanged();
}

Outcome QuickScreen::copyToClipboard(const std::string& text)
{
    QGuiApplication::clipboard()->setText(QString::fromStdString(text));
    return Done {};
}

// ---- What the QML asks and reports

bool QuickScreen::isWindowShown() const
{
    const SpectrelApp* app = application();
    return app && app->window() && app->window()->isKeyAndVisible;
}

void QuickScreen::setDark(bool isDark)
{
    if (std::exchange(_isDark, isDark) != isDark)
        emit isDarkChanged();
}

QString QuickScreen::alertTitle() const
{
    return hasAlert() ? shownText(_alerts.front().title) : QString();
}

QString QuickScreen::alertMessage() const
{
    return hasAlert() ? shownText(_alerts.front().message) : QString();
}

QString QuickScreen::alertButton() const
{
    return hasAlert() ? shownText(_alerts.front().button) : QString();
}

QString QuickScreen::notice() const
{
    const SpectrelApp* app = application();
    if (app && app->copying() && !app->copying()->message().empty())
        return shownText(app->copying()->message());
    return app && app->playback() ? shownText(app->playback()->notice()) : QString();
}

QString QuickScreen::aboutName()
{
    return shownText(AboutText::text().name);
}

QString QuickScreen::aboutVersion()
{
    return shownText(AboutText::text().version);
}

QString QuickScreen::aboutSummary()
{
    return shownText(AboutText::text().summary);
}

void QuickScreen::begin(double width, double height)
{
    resize(width, height);
    _isReady = true;
    adoptPanes(Animation::None);
}

void QuickScreen::resize(double width, double height)
{
    _size = {width, height};
}

void QuickScreen::closeAlert()
{
    if (!hasAlert())
        return;
    _alerts.pop_front();
    emit alertChanged();
}

void QuickScreen::copyRow(int row)
{
    const SpectrelApp* app = application();
    if (app && app->copying() && row >= 0)
        app->copying()->copyRow(*app->navController()->topViewController(), static_cast<std::size_t>(row));
}

void QuickScreen::copyPane()
{
    const SpectrelApp* app = application();
    if (app && app->copying())
        app->copying()->copyPane(*app->navController()->topViewController());
}

void QuickScreen::clearNotice()
{
    const SpectrelApp* app = application();
    if (app && app->copying())
        app->copying()->clearMessage();
}

void QuickScreen::quit()
{
    _quit();
}

} // namespace spectrel
