#include "CommandLine/Program/ViewingApplication.h"

#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/ExitStatus.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/Snapshot.h"
#include "Platform/Preferences.h"
#include "UI/SpectrelApp.h"

namespace spectrel {

int runViewingApplication(
    ViewedFile& file, const std::string& path, QtRunLoop& runLoop, ScreenToolkit& toolkit, const Context& context)
{
    const auto tell = [&path](const std::string& line) { report(path + ": " + line); };
    if (!file.damage().empty())
        tell(file.damage());
    NoPreferences preferences;
    SpectrelApp application({runLoop, file.clock(), context.log, preferences, toolkit,
        [&](SpectrelModelObserver& observer) {
            return file.makeModel(runLoop, &LogGenerator::generatorFromTechnology, observer, tell, context);
        },
        writeSnapshot, {}, false});
    application.applicationDidFinishLaunching();
    runLoop.run();
    application.applicationWillTerminate();
    return file.damage().empty() ? ExitStatus::Done : ExitStatus::Failed;
}

} // namespace spectrel
