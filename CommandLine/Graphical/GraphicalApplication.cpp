#include "CommandLine/Graphical/GraphicalApplication.h"

#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ExitStatus.h"
#include "CommandLine/Program/LiveApplication.h"
#include "CommandLine/Program/SingleInstance.h"
#include "CommandLine/Program/ViewingApplication.h"
#include "Monitor/Viewing/ViewedFile.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Qt/TerminationSignals.h"
#include "UI/Quick/QuickFrontEnd.h"

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

int runApplication(const GraphicalArguments& arguments, const Context& context)
{
    LiveServices live(context);
    SingleInstance instance(live.services().ports);
    QuickFrontEnd frontEnd(arguments.appearance);
    if (instance.activateOther(takeActivationToken()))
        return ExitStatus::Done;
    frontEnd.onQuit = [&live] { live.runLoop().quit(); };
    if (const Outcome started = frontEnd.start(); !started) {
        report("cannot open the graphical screens: " + started.failure().text);
        return ExitStatus::Failed;
    }
    const TerminationSignals endings([&live](int) { live.runLoop().quit(); });
    instance.serve([&frontEnd](const std::string& token) { frontEnd.raise(token); });
    runLiveApplication(live, frontEnd.toolkit(), {});
    frontEnd.stop();
    return ExitStatus::Done;
}

/// The screens in a window over a file.
int viewFile(const GraphicalArguments& arguments, const Context& context)
{
    const std::string& path = *arguments.viewedFile;
    QtRunLoop runLoop;
    QuickFrontEnd frontEnd(arguments.appearance);
    frontEnd.onQuit = [&runLoop] { runLoop.quit(); };
    std::string reason;
    const auto file = ViewedFile::open(path, arguments.technology, context.clock, reason);
    if (!file) {
        report(path + ": " + reason);
        return ExitStatus::Failed;
    }
    if (const Outcome started = frontEnd.start(); !started) {
        report("cannot open the graphical screens: " + started.failure().text);
        return ExitStatus::Failed;
    }
    const TerminationSignals endings([&runLoop](int) { runLoop.quit(); });
    const int status = runViewingApplication(*file, path, runLoop, frontEnd.toolkit(), context);
    frontEnd.stop();
    return status;
}

} // namespace

int runGraphicalApplication(const GraphicalArguments& arguments, const Context& context)
{
    if (arguments.viewedFile)
        return viewFile(arguments, context);
    return runApplication(arguments, context);
}

} // namespace spectrel
