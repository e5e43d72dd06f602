#include "CommandLine/Commands/Application.h"

#include "CommandLine/Commands/Screens.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveApplication.h"
#include "UI/Terminal/TerminalFrontEnd.h"
#include "UI/Terminal/TerminalGuard.h"

#include <string>

namespace spectrel {

namespace {

int runTerminal(const Context& context)
{
    LiveServices live(context);
    TerminalFrontEnd frontEnd(live.runLoop());
    frontEnd.onQuit = [&live] { live.runLoop().quit(); };
    if (const Outcome started = frontEnd.start(); !started) {
        report("cannot open the terminal screens: " + started.failure().text);
        return ExitStatus::Failed;
    }
    runLiveApplication(live, frontEnd.toolkit(), restoreTerminal);
    frontEnd.stop();
    return ExitStatus::Done;
}

} // namespace

int runApplication(const Arguments& arguments, const Context& context)
{
    const auto screens = findScreens(arguments.screens);
    if (!screens)
        return ExitStatus::Failed;
    if (screens == Screens::Graphical)
        return runGraphical(arguments, {});
    return screens == Screens::Terminal ? runTerminal(context) : watch(arguments.watch, context);
}

} // namespace spectrel
