// spectrel: the application with its terminal screens, and the commands watch, decode and record.

#include "CommandLine/Application.h"
#include "CommandLine/Arguments.h"
#include "CommandLine/Report.h"
#include "Platform/Console.h"
#include "Platform/Environment.h"
#include "Platform/Resources.h"
#include "Platform/Syslog/DiagnosticFile.h"
#include "Platform/Syslog/FileLog.h"
#include "Platform/Syslog/SyslogLog.h"

#include <memory>

namespace {

using namespace spectrel;

/// The least urgent lines that go to the system log; traces, a line for each section and record, stay out of it.
constexpr int SystemLogPriority = Priority::Error;
constexpr int EveryPriority = 7;

/// Chooses where log lines go: to a file every one of them; otherwise, for a live session, to the system log.
class Logging {
public:
    bool start(const Arguments& arguments)
    {
        return startDiagnostics() && startLog(arguments);
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
    bool startDiagnostics()
    {
        const std::string path = Places::diagnosticLog();
        std::string reason;
        if (!path.empty() && !(_diagnostics = DiagnosticFile::create(path, reason))) {
            report(path + ": " + reason);
            return false;
        }
        return true;
    }

    bool startLog(const Arguments& arguments)
    {
        if (arguments.logFile) {
            const bool isLive = arguments.job != Job::Decode;
            std::string reason;
            _file = FileLog::create(
                *arguments.logFile, isLive ? FileLog::Writing::EachLine : FileLog::Writing::Buffered, reason);
            if (!_file) {
                report(*arguments.logFile + ": " + reason);
                return false;
            }
            SystemLog::install(_file.get(), EveryPriority);
        } else if (arguments.job != Job::Decode) {
            _system = std::make_unique<SyslogLog>();
            SystemLog::install(_system.get(), SystemLogPriority);
        }
        return true;
    }

    std::unique_ptr<DiagnosticFile> _diagnostics;
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
