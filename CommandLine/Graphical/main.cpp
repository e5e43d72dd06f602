// spectrel-gui: the application with its graphical screens.

#include "CommandLine/Graphical/GraphicalApplication.h"
#include "CommandLine/Program/ExitStatus.h"
#include "CommandLine/Program/Logging.h"
#include "CommandLine/Program/ProgramFolders.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Context.h"
#include "Platform/Qt/QtClock.h"

#include <QGuiApplication>
#include <QIcon>

#include <clocale>
#include <csignal>

namespace {

using namespace spectrel;

constexpr const char* ApplicationId = "org.spectrel.Spectrel"; // names the desktop entry and the icon, too

} // namespace

int main(int argc, char** argv)
{
    GraphicalArguments arguments;
    if (const auto status = readArguments(argc, argv, arguments))
        return *status;

    std::signal(SIGXFSZ, SIG_IGN); // a file grown too large is a failed write like any other
    const auto templates = Surroundings::templates(arguments.resources);
    if (!templates || (!arguments.viewedFile && !Surroundings::preparePorts(SpectrelModel::ApplicationPrefix)))
        return ExitStatus::Failed;
    const DirectoryResources resources(*templates);
    StandardOutputConsole console;
    const QtClock clock;
    Logging logging;
    if (!logging.start(arguments.logFile, arguments.viewedFile ? Logging::Use::Offline : Logging::Use::Live))
        return ExitStatus::Failed;

    int programOnly = 1; // the toolkit's own options are no options of this program
    QGuiApplication application(programOnly, argv);
    std::setlocale(LC_NUMERIC, "C"); // the application object has adopted the user's locale; our numbers have none
    QGuiApplication::setQuitOnLastWindowClosed(false);
    QGuiApplication::setApplicationDisplayName("Spectrel");
    QGuiApplication::setApplicationVersion(SPECTREL_VERSION);
    QGuiApplication::setDesktopFileName(ApplicationId);
    QGuiApplication::setWindowIcon(QIcon::fromTheme(ApplicationId));

    const int status =
        runGraphicalApplication(arguments, {clock, resources, logging.log(), console, logging.diagnostics()});
    return logging.finish() ? status : ExitStatus::Failed;
}
