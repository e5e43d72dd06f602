#include "CommandLine/GraphicalApplication.h"

#include "CommandLine/ExitStatus.h"
#include "CommandLine/LiveApplication.h"
#include "CommandLine/Report.h"
#include "CommandLine/SingleInstance.h"
#include "CommandLine/ViewedFile.h"
#include "Monitor/Snapshot.h"
#include "Platform/Preferences.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Qt/TerminationSignals.h"
#include "UI/Quick/QuickFrontEnd.h"
#include "UI/SpectrelApp.h"

#include <cstdlib>
#include <utility>

namespace spectrel {

namespace {

/// Takes the compositor's leave to come to the front out of the environment, where children would inherit it.
std::string takeActivationToken()
{
    const char* token = std::getenv("XDG_ACTIVATION_TOKEN");
    std::string taken = token ? token : "";
    ::unsetenv("XDG_ACTIVATION_TOKEN");
    return taken;
}

int runApplication(const GraphicalArguments& arguments)
{
    LiveServices live;
    SingleInstance instance(live.services().ports);
    QuickFrontEnd frontEnd(arguments.appearance);
    if (instance.activateOther(takeActivationToken()))
        return ExitStatus::Done;
    frontEnd.onQuit = [&live] { live.runLoop().quit(); };
    std::string reason;
    if (!frontEnd.start(reason)) {
        report("cannot open the graphical screens: " + reason);
        return ExitStatus::Failed;
    }
    const TerminationSignals endings([&live](int) { live.runLoop().quit(); });
    instance.serve([&frontEnd](const std::string& token) { frontEnd.raise(token); });
    runLiveApplication(live, frontEnd.toolkit(), {});
    frontEnd.stop();
    return ExitStatus::Done;
}

/// The screens in a window over a file, for one run. No session is started, nothing is saved.
class GraphicalViewing {
public:
    explicit GraphicalViewing(const GraphicalArguments& arguments)
        : _path(*arguments.viewedFile)
        , _frontEnd(arguments.appearance)
    {
        _frontEnd.onQuit = [this] { _runLoop.quit(); };
    }

    int run(std::optional<Technology> technology)
    {
        std::string reason;
        const auto file = ViewedFile::open(_path, technology, _deviceClock, reason);
        if (!file) {
            tell(reason);
            return ExitStatus::Failed;
        }
        if (!_frontEnd.start(reason)) {
            report("cannot open the graphical screens: " + reason);
            return ExitStatus::Failed;
        }
        if (!file->damage().empty())
            tell(file->damage());
        const TerminationSignals endings([this](int) { _runLoop.quit(); });
        SpectrelApp application({_runLoop, file->clock(), _preferences, _frontEnd.toolkit(),
            [&](SpectrelModelObserver& observer) {
                return file->makeModel(_runLoop, observer, [this](const std::string& line) { tell(line); });
            },
            writeSnapshot, {}, false});
        application.applicationDidFinishLaunching();
        _runLoop.run();
        application.applicationWillTerminate();
        _frontEnd.stop();
        return file->damage().empty() ? ExitStatus::Done : ExitStatus::Failed;
    }

private:
    void tell(const std::string& line) const
    {
        report(_path + ": " + line);
    }

    std::string _path;
    QtRunLoop _runLoop;
    QtClock _deviceClock;
    NoPreferences _preferences;
    QuickFrontEnd _frontEnd;
};

} // namespace

int runGraphicalApplication(const GraphicalArguments& arguments)
{
    if (arguments.viewedFile)
        return GraphicalViewing(arguments).run(arguments.technology);
    return runApplication(arguments);
}

} // namespace spectrel
