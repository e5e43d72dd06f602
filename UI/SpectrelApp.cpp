#include "UI/SpectrelApp.h"

#include "Platform/Places.h"
#include "UI/SpectrelPaneController.h"

#include <filesystem>
#include <system_error>
#include <utility>

namespace spectrel {

namespace {

constexpr const char* ConnectingAgain = "Connecting...";
constexpr const char* ConnectingFirst = "Connecting"; // the root pane's first status, at launch only
constexpr const char* UpdatedPattern = "'Updated' yyyy-MM-dd 'at' HH:mm:ss";

SpectrelApp* sharedInstance = nullptr;

} // namespace

SpectrelApp::SpectrelApp(Services services)
    : _services(std::move(services))
{
    sharedInstance = this;
    _services.toolkit.setApplication(this);
}

SpectrelApp::~SpectrelApp()
{
    // Closing the session calls its observer, who must find no model by then.
    _playback.reset();
    _model.reset();
    if (sharedInstance == this)
        sharedInstance = nullptr;
    if (_services.toolkit.application() == this)
        _services.toolkit.setApplication(nullptr);
}

SpectrelApp* SpectrelApp::sharedApplication()
{
    return sharedInstance;
}

void SpectrelApp::applicationDidFinishLaunching()
{
    getSaveButtonPref();
    const Size screen = _services.toolkit.mainScreenSize();
    _window = std::make_unique<Window>(Window {{0, 0, screen.width, screen.height}});
    _model = _services.makeModel(*this);
    if (Playback* playback = _model->playback())
        _playback = std::make_unique<PlaybackController>(*playback);
    setUpdateMessage(ConnectingAgain);
    _dateFormatter = std::make_unique<DateFormatter>(_services.clock, UpdatedPattern);

    auto root = std::make_shared<SpectrelPaneController>(*this, _services.toolkit, nullptr, "/");
    root->setStatus(ConnectingFirst, true);
    _navController = std::make_unique<NavigationController>(_services.toolkit, std::move(root));
    _navController->setDelegate(this);
    _find = std::make_unique<FindController>(_services.toolkit, *_navController);
    _copying = std::make_unique<CopyController>(_services.toolkit);

    _window->rootViewController = _navController.get();
    _window->isKeyAndVisible = true;
    _navController->topViewController()->viewWillAppear();
    _services.toolkit.screenDidChange(ScreenPart::Window, Animation::None);

    _services.runLoop.async([] {
        if (sharedInstance && sharedInstance->_model)
            sharedInstance->_model->restartMonitor();
    });
}

void SpectrelApp::applicationWillTerminate()
{
    setGSMRSSI(false);
    _updateMessage.clear();
    _dateFormatter.reset();
    setSaveViewController(nullptr);
    if (_window) {
        _window->isKeyAndVisible = false;
        _services.toolkit.screenDidChange(ScreenPart::Window, Animation::None);
    }
    setWindow(nullptr);
    _playback.reset();
    _model.reset();
}

void SpectrelApp::getSaveButtonPref()
{
    std::error_code error;
    const auto status = std::filesystem::symlink_status(Places::devicePath(SaveMarker), error);
    setAllowSaveButton(_services.offersSaving && std::filesystem::exists(status));
}

void SpectrelApp::setGSMRSSI(bool shows)
{
    _services.preferences.setBoolean(HomeScreenDomain, ShowRSSIKey, shows);
    _services.preferences.synchronize(HomeScreenDomain);
    _services.preferences.postChanged(HomeScreenDomain, ShowRSSIKey);
}

void SpectrelApp::showSaveView()
{
    if (_saveViewController || !_model)
        return;
    setSaveViewController(std::make_unique<SpectrelSaveViewController>(
        SpectrelSaveViewController::Services {*this, _services.toolkit, _services.clock, _services.log,
            _services.writeSnapshot, _services.snapshotDirectory},
        _model->getSaveContents()));
    _saveViewController->viewWillAppear();
    _services.toolkit.screenDidChange(ScreenPart::Modal, Animation::Animated);
}

void SpectrelApp::closeSaveView()
{
    if (!_saveViewController)
        return;
    setSaveViewController(nullptr);
    _services.toolkit.screenDidChange(ScreenPart::Modal, Animation::Animated);
}

void SpectrelApp::saveViewDidFinish()
{
    _services.runLoop.async([] {
        if (sharedInstance)
            sharedInstance->closeSaveView();
    });
}

void SpectrelApp::updateStatusForViewController(SpectrelPaneController& pane)
{
    if (_model && _model->isConnected())
        pane.setStatus(_updateMessage, false);
    else
        pane.setStatus(ConnectingAgain, true);
}

/// Hands every pane its node of the current tree, bottom first; a pane without one goes, and all above it.
void SpectrelApp::reloadPanes()
{
    const NavigationController::Panes panes = _navController->viewControllers();
    for (std::size_t index = 0; index < panes.size(); ++index) {
        NodeRef node = index == 0 ? _model->topLevelNodes() : _model->nodeAtPath(panes[index]->path());
        if (index > 0 && !node) {
            _navController->popToViewControllerAtIndex(index - 1, Animation::Animated);
            return;
        }
        panes[index]->reloadWithNode(std::move(node));
    }
}

void SpectrelApp::updateViewControllerFromModel()
{
    if (!_model || !_navController)
        return;
    reloadPanes();
    if (_model->isConnected())
        setUpdateMessage(_dateFormatter->stringFromDate(_services.clock.now()));
    updateStatusForViewController(*_navController->topViewController());
    _find->treeDidReload();
}

void SpectrelApp::playbackDidChange()
{
    _services.toolkit.screenDidChange(ScreenPart::Playback, Animation::None);
}

void SpectrelApp::sessionDidChange()
{
    if (!_model || !_navController)
        return;
    SpectrelPaneController& top = *_navController->topViewController();
    if (_model->isConnected()) {
        top.createToolbarItems(); // the reason goes; the status waits for the first reload
        return;
    }
    // The time of the last update must not come back as the status of a session that has shown nothing yet.
    setUpdateMessage(ConnectingAgain);
    updateStatusForViewController(top);
}

void SpectrelApp::navigationControllerWillShowViewController(
    NavigationController&, SpectrelPaneController& pane, Animation)
{
    updateStatusForViewController(pane);
}

const std::string& SpectrelApp::lostReason() const
{
    static const std::string none;
    return _model ? _model->lostReason() : none;
}

} // namespace spectrel
