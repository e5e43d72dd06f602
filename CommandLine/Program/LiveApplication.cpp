#include "CommandLine/Program/LiveApplication.h"

#include "CommandLine/Program/CrashReport.h"
#include "LogGenerator/LogGenerator.h"
#include "Monitor/Snapshot.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Places.h"
#include "Platform/Qt/QtPreferences.h"
#include "UI/SpectrelApp.h"

#include <memory>
#include <string>

namespace spectrel {

namespace {

/// The model is gone after the application object: from then on nothing is left to save.
struct EndingGuard {
    EndingGuard() = default;
    EndingGuard(const EndingGuard&) = delete;
    EndingGuard& operator=(const EndingGuard&) = delete;
    ~EndingGuard()
    {
        Ending::remove();
    }
};

} // namespace

void runLiveApplication(LiveServices& live, ScreenToolkit& toolkit, const std::function<void()>& restoreScreen)
{
    QtPreferences preferences(Places::preferencesDirectory());
    const auto makeModel = [&](SpectrelModelObserver& observer) -> std::unique_ptr<MonitorModel> {
        auto model = std::make_unique<SpectrelModel>(live.services(), &LogGenerator::generatorFromTechnology, observer,
            std::string(SpectrelModel::ApplicationPrefix));
        Ending::install(model->displayState(), live.context(), restoreScreen);
        return model;
    };
    SpectrelApp application({live.runLoop(), live.clock(), live.context().log, preferences, toolkit, makeModel,
        writeSnapshot, Places::crashLogDirectory()});
    {
        const EndingGuard guard;
        application.applicationDidFinishLaunching();
        live.runLoop().run();
    }
    application.applicationWillTerminate();
}

} // namespace spectrel
