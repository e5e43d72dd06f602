// spectrel: the application with its terminal screens, and the commands watch, decode, view and record.

#include "CommandLine/Application.h"
#include "CommandLine/Arguments.h"
#include "CommandLine/Report.h"
#include "Platform/Console.h"
#include "Platform/Environment.h"
#include "Platform/Resources.h"
#include "Platform/Syslog/FileLog.h"
#include "Platform/Syslog/SyslogLog.h"

#include <csignal>
#include <memory>

namespace {

using namespace spectrel;

/// The least urgent lines that go to the system log; traces, a line for each section and record, stay out of it.
constexpr int SystemLogPriority = Priority::Error;
constexpr int EveryPriority = 7;

/// A live session tells the system log, a recording that is decoded again does not.
bool isLive(Job job)
{
    return job != Job::Decode && job != Job::View;
}

/// Chooses where log lines go: to a file every one of them; otherwise, for a live session, to the system log.
class Logging {
public:
    bool start(const Arguments& arguments)
    {
        if (arguments.logFile) {
            std::string reason;
            _file = FileLog::create(*arguments.logFile,
                isLive(arguments.job) ? FileLog::Writing::EachLine : FileLog::Writing::Buffered, reason);
            if (!_file) {
                report(*arguments.logFile + ": " + reason);
                return false;
            }
            SystemLog::install(_file.get(), EveryPriority);
        } else if (isLive(arguments.job)) {
            _system = std::make_unique<SyslogLog>();
            SystemLog::install(_system.get(), SystemLogPriority);
        }
        return true;
    }

    /// False when a line could not be written.
    bool finish(const Arguments& arguments)
    {
        SystemLog::install(nullptr, -1);
        if (!_file || _file->flush())
            return true;
        report(*arguments.logFile + ": the log could not be written whole");
        return false;
    }

private:
    std::unique_ptr<FileLog> _file;
    std::unique_ptr<SyslogLog> _system;
};

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

} // namespace

int main(int argc, char** argv)
{
    Arguments arguments;
    if (const auto status = readArguments(argc, argv, arguments))
        return *status;

    std::signal(SIGXFSZ, SIG_IGN); // a file grown too large is a failed write like any other
    const DirectoryResources resources(arguments.resources.value_or(Places::resourcesDirectory()));
    Resources::install(&resources);
    StandardErrorConsole console;
    Console::install(&console);
    Logging logging;
    if (!logging.start(arguments))
        return ExitStatus::Failed;
    const int status = run(arguments);
    return logging.finish(arguments) ? status : ExitStatus::Failed;
}
