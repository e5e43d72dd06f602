#pragma once

#include "Monitor/MonitorModel.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Clock.h"
#include "Platform/Preferences.h"
#include "Platform/RunLoop.h"
#include "Platform/SystemLog.h"
#include "UI/Application.h"
#include "UI/CopyController.h"
#include "UI/FindController.h"
#include "UI/NavigationController.h"
#include "UI/PlaybackController.h"
#include "UI/ScreenToolkit.h"
#include "UI/SpectrelSaveViewController.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>

namespace spectrel {

/// The one full-screen window.
struct Window {
    Rect frame;
    NavigationController* rootViewController = nullptr;
    bool isKeyAndVisible = false;
};

/// Formats moments in the device's time zone by a fixed pattern.
class DateFormatter {
public:
    DateFormatter(const Clock& clock, std::string pattern)
        : _clock(clock)
        , _pattern(std::move(pattern))
    {
    }
    std::string stringFromDate(Moment moment) const
    {
        return _clock.formatted(moment, _pattern);
    }

private:
    const Clock& _clock;
    std::string _pattern;
};

/// The application object: the window with its stack of panes, the model, the status line and the save screen.
///
/// A front end creates it, calls `applicationDidFinishLaunching`, runs the run loop, and calls
/// `applicationWillTerminate` when that has ended. There is one at a time.
class SpectrelApp final : public Application, public SpectrelModelObserver, public NavigationControllerDelegate {
public:
    static constexpr const char* SaveMarker = "/VexelInternal/Library/PreferenceBundles/Carrier Settings.bundle";
    static constexpr std::string_view HomeScreenDomain = "org.spectrel.HomeScreen";
    static constexpr std::string_view ShowRSSIKey = "THShowGSMRSSI";

    using ModelFactory = std::function<std::unique_ptr<MonitorModel>(SpectrelModelObserver& observer)>;
    /// What the application needs of the platform; all outlive it.
    struct Services {
        RunLoop& runLoop;
        const Clock& clock;
        SystemLog& log;
        Preferences& preferences;
        ScreenToolkit& toolkit;
        ModelFactory makeModel; // called once, at launch; the model must not call back while it is being made
        SpectrelSaveViewController::SnapshotWriter writeSnapshot;
        std::string snapshotDirectory;
        bool offersSaving = true; // false: what is shown is a file already, and the marker does not count
    };

    explicit SpectrelApp(Services services);
    ~SpectrelApp() override;
    SpectrelApp(const SpectrelApp&) = delete;
    SpectrelApp& operator=(const SpectrelApp&) = delete;

    /// The single instance; null while there is none.
    static SpectrelApp* sharedApplication();

    void applicationDidFinishLaunching();
    void applicationWillTerminate();

    void getSaveButtonPref();
    /// `_setGSMRSSI`: has the home screen show, or no longer show, the signal strength as a number.
    void setGSMRSSI(bool shows);
    void showSaveView() override;
    void closeSaveView();
    void saveViewDidFinish() override;
    void updateStatusForViewController(SpectrelPaneController& pane);

    void updateViewControllerFromModel() override;
    void sessionDidChange() override;
    void playbackDidChange() override;
    void navigationControllerWillShowViewController(
        NavigationController& navigationController, SpectrelPaneController& pane, Animation animated) override;

    bool allowSaveButton() const override
    {
        return _allowSaveButton;
    }
    void setAllowSaveButton(bool allows)
    {
        _allowSaveButton = allows;
    }
    const std::string& updateMessage() const
    {
        return _updateMessage;
    }
    void setUpdateMessage(std::string message)
    {
        _updateMessage = std::move(message);
    }
    /// Null before launch and after termination.
    Window* window() const
    {
        return _window.get();
    }
    void setWindow(std::unique_ptr<Window> window)
    {
        _window = std::move(window);
    }
    /// The save screen while it is shown, else null.
    SpectrelSaveViewController* saveViewController() const
    {
        return _saveViewController.get();
    }
    void setSaveViewController(std::unique_ptr<SpectrelSaveViewController> controller)
    {
        _saveViewController = std::move(controller);
    }
    /// Null before launch.
    NavigationController* navController() const
    {
        return _navController.get();
    }
    MonitorModel* model() const
    {
        return _model.get();
    }
    /// The search in the tree, and the copying; null before launch.
    FindController* find() const
    {
        return _find.get();
    }
    CopyController* copying() const
    {
        return _copying.get();
    }
    /// The playback line; null where nothing is played.
    PlaybackController* playback() const
    {
        return _playback.get();
    }
    const std::string& lostReason() const override;

private:
    void reloadPanes();

    Services _services;
    std::unique_ptr<Window> _window;
    std::unique_ptr<NavigationController> _navController;
    std::unique_ptr<SpectrelSaveViewController> _saveViewController;
    std::unique_ptr<FindController> _find;
    std::unique_ptr<CopyController> _copying;
    std::unique_ptr<MonitorModel> _model;
    std::unique_ptr<PlaybackController> _playback;
    bool _allowSaveButton = false;
    std::unique_ptr<DateFormatter> _dateFormatter;
    std::string _updateMessage;
};

} // namespace spectrel
