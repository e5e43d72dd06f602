#include "CommandLine/Commands/Application.h"

#include "CommandLine/Commands/Screens.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveApplication.h"
#include "UI/Terminal/TerminalFrontEnd.h"
#include "UI/Terminal/TerminalGuard.h"

#include <string>

namespace spectrel {

namespace {

int runTerminal()
{
    LiveServices live;
    TerminalFrontEnd frontEnd(live.runLoop());
    frontEnd.onQuit = [&live] { live.runLoop().quit(); };
    std::string reason;
    if (!frontEnd.start(reason)) {
        report("cannot open the terminal screens: " + reason);
        return ExitStatus::Failed;
    }
    runLiveApplication(live, frontEnd.toolkit(), restoreTerminal);
    frontEnd.stop();
    return ExitStatus::Done;
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
