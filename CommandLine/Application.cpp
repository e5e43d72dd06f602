#include "CommandLine/Application.h"

#include "CommandLine/Ending.h"
#include "CommandLine/LiveServices.h"
#include "CommandLine/Report.h"
#include "Monitor/Snapshot.h"
#include "Platform/Environment.h"
#include "Platform/Qt/QtPreferences.h"
#include "UI/SpectrelApp.h"
#include "UI/Terminal/TerminalFrontEnd.h"
#include "UI/Terminal/TerminalGuard.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <system_error>
#include <unistd.h>

namespace spectrel {

namespace {

bool isSet(const char* variable)
{
    const char* value = std::getenv(variable);
    return value && *value;
}

/// The program with the graphical screens stands beside this one where it is installed.
std::string graphicalProgram()
{
    std::error_code error;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", error);
    return (program.parent_path() / "spectrel-gui").string();
}

/// Becomes the graphical program; comes back only when that fails.
int runGraphical(const std::string& program)
{
    ::execl(program.c_str(), program.c_str(), static_cast<char*>(nullptr));
    report("cannot open the graphical screens: " + program + ": " + std::strerror(errno));
    return ExitStatus::Failed;
}

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
    const std::string graphical = graphicalProgram();
    if (arguments.screens == ScreenChoice::Graphical)
        return runGraphical(graphical);
    const bool hasTerminal = ::isatty(STDIN_FILENO) && ::isatty(STDOUT_FILENO);
    if (arguments.screens == ScreenChoice::Terminal) {
        if (hasTerminal)
            return runTerminal();
        report("cannot open the terminal screens: standard input and output are no terminal");
        return ExitStatus::Failed;
    }
    const bool hasDisplay = isSet("WAYLAND_DISPLAY") || isSet("DISPLAY");
    if (hasDisplay && ::access(graphical.c_str(), X_OK) == 0)
        return runGraphical(graphical);
    return hasTerminal ? runTerminal() : watch(arguments.watch);
}

} // namespace spectrel
