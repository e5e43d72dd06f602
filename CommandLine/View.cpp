#include "CommandLine/View.h"

#include "CommandLine/Arguments.h"
#include "CommandLine/Report.h"
#include "CommandLine/Screens.h"
#include "CommandLine/ViewedFile.h"
#include "Monitor/Snapshot.h"
#include "Platform/Preferences.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "UI/SpectrelApp.h"
#include "UI/Terminal/TerminalFrontEnd.h"

namespace spectrel {

namespace {

int viewGraphically(const Arguments& arguments)
{
    std::vector<std::string> options {"--view=" + arguments.view.file};
    if (arguments.view.technology)
        options.insert(options.end(), {"--technology", std::string(technologyName(*arguments.view.technology))});
    return runGraphical(arguments, std::move(options));
}

/// The screens in the terminal over a file, for one run.
class TerminalViewing {
public:
    TerminalViewing()
        : _frontEnd(_runLoop)
    {
        _frontEnd.onQuit = [this] { _runLoop.quit(); };
    }

    int run(const std::string& path, ViewedFile& file)
    {
        std::string reason;
        if (!_frontEnd.start(reason)) {
            report("cannot open the terminal screens: " + reason);
            return ExitStatus::Failed;
        }
        // Lines on standard error come out when the screens are closed.
        const auto tell = [&path](const std::string& line) { report(path + ": " + line); };
        if (!file.damage().empty())
            tell(file.damage());
        SpectrelApp application({_runLoop, file.clock(), _preferences, _frontEnd.toolkit(),
            [&](SpectrelModelObserver& observer) { return file.makeModel(_runLoop, observer, tell); }, writeSnapshot,
            {}, false});
        application.applicationDidFinishLaunching();
        _runLoop.run();
        application.applicationWillTerminate();
        _frontEnd.stop();
        return file.damage().empty() ? ExitStatus::Done : ExitStatus::Failed;
    }

private:
    QtRunLoop _runLoop;
    NoPreferences _preferences;
    TerminalFrontEnd _frontEnd;
};

} // namespace

int view(const Arguments& arguments)
{
    const auto screens = findScreens(arguments.screens);
    if (!screens)
        return ExitStatus::Failed;
    if (screens == Screens::Graphical)
        return viewGraphically(arguments);
    const QtClock deviceClock;
    std::string reason;
    const auto file = ViewedFile::open(arguments.view.file, arguments.view.technology, deviceClock, reason);
    if (!file) {
        report(arguments.view.file + ": " + reason);
        return ExitStatus::Failed;
    }
    if (screens == Screens::Terminal)
        return TerminalViewing().run(arguments.view.file, *file);
    report(arguments.view.file + ": there is neither a terminal nor a display to show it; spectrel decode prints it");
    return ExitStatus::Failed;
}

} // namespace spectrel
