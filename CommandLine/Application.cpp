#include "CommandLine/Application.h"

#include "CommandLine/Ending.h"
#include "CommandLine/LiveServices.h"
#include "CommandLine/Report.h"
#include "CommandLine/Screens.h"
#include "Monitor/Snapshot.h"
#include "Platform/Environment.h"
#include "Platform/Qt/QtPreferences.h"
#include "UI/SpectrelApp.h"
#include "UI/Terminal/TerminalFrontEnd.h"
#include "UI/Terminal/TerminalGuard.h"

#include <memory>
#include <string>

namespace spectrel {

namespace {

/// The application in the terminal: its services, its screens and the application object, for one run.
class TerminalApplication {
public:
    TerminalApplication()
        : _preferences(Places::preferencesDirectory())
        , _frontEnd(_live.runLoop())
    {
        _frontEnd.onQuit = [this] { _live.runLoop().quit(); };
    }
    ~TerminalApplication()
    {
        Ending::remove();
    }
    TerminalApplication(const TerminalApplication&) = delete;
    TerminalApplication& operator=(const TerminalApplication&) = delete;

    int run()
    {
        std::string reason;
        if (!_frontEnd.start(reason)) {
            report("cannot open the terminal screens: " + reason);
            return ExitStatus::Failed;
        }
        SpectrelApp application({_live.runLoop(), _live.clock(), _preferences, _frontEnd.toolkit(),
            [this](SpectrelModelObserver& observer) { return makeModel(observer); }, writeSnapshot,
            Places::crashLogDirectory()});
        application.applicationDidFinishLaunching();
        _live.runLoop().run();
        Ending::remove();
        application.applicationWillTerminate();
        _frontEnd.stop();
        return ExitStatus::Done;
    }

private:
    std::unique_ptr<MonitorModel> makeModel(SpectrelModelObserver& observer)
    {
        auto model =
            std::make_unique<SpectrelModel>(_live.services(), observer, std::string(SpectrelModel::ApplicationPrefix));
        Ending::install(*model, restoreTerminal);
        return model;
    }

    LiveServices _live;
    QtPreferences _preferences;
    TerminalFrontEnd _frontEnd;
};

int runTerminal()
{
    return TerminalApplication().run();
}

} // namespace

int runApplication(const Arguments& arguments)
{
    const auto screens = findScreens(arguments.screens);
    if (!screens)
        return ExitStatus::Failed;
    if (screens == Screens::Graphical)
        return runGraphical(arguments, {});
    return screens == Screens::Terminal ? runTerminal() : watch(arguments.watch);
}

} // namespace spectrel
