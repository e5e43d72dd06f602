// spectrel: the application with its terminal screens, and the commands watch, decode, view and record.

#include "CommandLine/Commands/Application.h"
#include "CommandLine/Commands/Arguments.h"
#include "CommandLine/Program/ErrorLine.h"
#include "CommandLine/Program/LiveServices.h"
#include "CommandLine/Program/Logging.h"
#include "CommandLine/Program/ProgramFolders.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Console.h"
#include "Platform/Resources.h"

#include <csignal>
#include <system_error>

namespace {

using namespace spectrel;

/// A live session tells the system log, a recording that is decoded again does not.
bool isLive(Job job)
{
    return job != Job::Decode && job != Job::View;
}

std::string portPrefix(Job job)
{
    switch (job) {
    case Job::Watch:
        return LiveServices::portPrefixFor("Watch");
    case Job::Record:
        return LiveServices::portPrefixFor("Record");
    default:
        return std::string(SpectrelModel::ApplicationPrefix);
    }
}

int run(const Arguments& arguments)
{
    switch (arguments.job) {
    case Job::Watch:
        return watch(arguments.watch);
    case Job::Decode:
        return decode(arguments.decode);
    case Job::View:
        return view(arguments);
    case Job::Record:
        return record(arguments.record);
    case Job::Application:
        return runApplication(arguments);
    }
    return ExitStatus::Failed;
}

/// The system may give not even what every program needs, such as descriptors.
int runUnlessExhausted(const Arguments& arguments)
{
    try {
        return run(arguments);
    } catch (const std::system_error& error) {
        report(error.what());
        return ExitStatus::Failed;
    }
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    if (const auto status = readArguments(argc, argv, arguments))
        return *status;

    std::signal(SIGXFSZ, SIG_IGN); // a file grown too large is a failed write like any other
    if (isLive(arguments.job))
        std::signal(SIGPIPE, SIG_IGN); // a reader that has gone, too: the session is still to be closed
    const auto templates = Surroundings::templates(arguments.resources);
    if (!templates || (isLive(arguments.job) && !Surroundings::preparePorts(portPrefix(arguments.job))))
        return ExitStatus::Failed;
    const DirectoryResources resources(*templates);
    Resources::install(&resources);
    StandardErrorConsole console;
    Console::install(&console);
    Logging logging;
    if (!logging.start(arguments.logFile, isLive(arguments.job) ? Logging::Use::Live : Logging::Use::Offline))
        return ExitStatus::Failed;
    const int status = runUnlessExhausted(arguments);
    return logging.finish() ? status : ExitStatus::Failed;
}
