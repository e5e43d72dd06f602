#include "CommandLine/Commands/View.h"

#include "CommandLine/Commands/Arguments.h"
#include "CommandLine/Commands/Screens.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ViewingApplication.h"
#include "Monitor/Viewing/ViewedFile.h"
#include "Platform/Qt/QtRunLoop.h"
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

/// The screens in the terminal over a file. Lines on standard error come out when the screens are closed.
int viewInTerminal(const std::string& path, ViewedFile& file, const Context& context)
{
    QtRunLoop runLoop;
    TerminalFrontEnd frontEnd(runLoop);
    frontEnd.onQuit = [&runLoop] { runLoop.quit(); };
    if (const Outcome started = frontEnd.start(); !started) {
        report("cannot open the terminal screens: " + started.failure().text);
        return ExitStatus::Failed;
    }
    const int status = runViewingApplication(file, path, runLoop, frontEnd.toolkit(), context);
    frontEnd.stop();
    return status;
}

} // namespace

int view(const Arguments& arguments, const Context& context)
{
    const auto screens = findScreens(arguments.screens);
    if (!screens)
        return ExitStatus::Failed;
    if (screens == Screens::Graphical)
        return viewGraphically(arguments);
    std::string reason;
    const auto file = ViewedFile::open(arguments.view.file, arguments.view.technology, context.clock, reason);
    if (!file) {
        report(arguments.view.file + ": " + reason);
        return ExitStatus::Failed;
    }
    if (screens == Screens::Terminal)
        return viewInTerminal(arguments.view.file, *file, context);
    report(arguments.view.file + ": there is neither a terminal nor a display to show it; spectrel decode prints it");
    return ExitStatus::Failed;
}

} // namespace spectrel
