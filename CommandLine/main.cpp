// spectrel: the application with its terminal screens, and the commands.

#include "CommandLine/Commands/Application.h"
#include "CommandLine/Commands/Arguments.h"
#include "CommandLine/Program/LiveServices.h"
#include "CommandLine/Program/Logging.h"
#include "CommandLine/Program/ProgramFolders.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Context.h"
#include "Platform/Qt/QtClock.h"

#include <csignal>

namespace {

using namespace spectrel;

/// A live session tells the system log, a recording that is decoded again does not.
bool isLive(Job job)
{
    return job != Job::Decode && job != Job::View && job != Job::Mark && job != Job::Report;
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

int run(const Arguments& arguments, const Context& context)
{
    switch (arguments.job) {
    case Job::Watch:
        return watch(arguments.watch, context);
    case Job::Decode:
        return decode(arguments.decode, context);
    case Job::View:
        return view(arguments, context);
    case Job::Record:
        return record(arguments.record, context);
    case Job::Mark:
        return mark(arguments.mark, context);
    case Job::Channel:
        return channel(arguments.channel);
    case Job::Report:
        return writeReport(arguments.report, context);
    case Job::Application:
        return runApplication(arguments, context);
    }
    return ExitStatus::Failed;
}

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    if (const auto status = readArguments(argc, argv, arguments))
        return *status;
    if (arguments.job == Job::Channel)
        return channel(arguments.channel); // needs neither templates nor a session

    std::signal(SIGXFSZ, SIG_IGN); // a file grown too large is a failed write like any other
    if (isLive(arguments.job))
        std::signal(SIGPIPE, SIG_IGN); // a reader that has gone, too: the session is still to be closed
    const auto templates = Surroundings::templates(arguments.resources);
    if (!templates || (isLive(arguments.job) && !Surroundings::preparePorts(portPrefix(arguments.job))))
        return ExitStatus::Failed;
    const DirectoryResources resources(*templates);
    StandardErrorConsole console;
    const QtClock clock;
    Logging logging;
    if (!logging.start(arguments.logFile, isLive(arguments.job) ? Logging::Use::Live : Logging::Use::Offline))
        return ExitStatus::Failed;
    const int status = run(arguments, {clock, resources, logging.log(), console, logging.diagnostics()});
    return logging.finish() ? status : ExitStatus::Failed;
}
