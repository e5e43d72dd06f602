#include "CommandLine/Program/Logging.h"

#include "CommandLine/Program/ErrorLine.h"
#include "Platform/Places.h"
#include "Platform/SystemLog.h"

namespace spectrel {

namespace {

/// The least urgent lines that go to the system log; traces, a line for each section and record, stay out of it.
constexpr int SystemLogPriority = Priority::Error;
constexpr int EveryPriority = 7;

} // namespace

bool Logging::start(const std::optional<std::string>& file, Use use)
{
    return startDiagnostics() && startLog(file, use);
}

bool Logging::startDiagnostics()
{
    const std::string path = Places::diagnosticLog();
    if (path.empty())
        return true;
    auto created = DiagnosticFile::create(path);
    if (!created) {
        report(created.failure().of(path).text);
        return false;
    }
    _diagnostics = *std::move(created);
    return true;
}

bool Logging::startLog(const std::optional<std::string>& file, Use use)
{
    if (file) {
        _path = *file;
        auto created =
            FileLog::create(_path, use == Use::Live ? FileLog::Writing::EachLine : FileLog::Writing::Buffered);
        if (!created) {
            report(created.failure().of(_path).text);
            return false;
        }
        _file = *std::move(created);
        SystemLog::install(_file.get(), EveryPriority);
    } else if (use == Use::Live) {
        _system = std::make_unique<SyslogLog>();
        SystemLog::install(_system.get(), SystemLogPriority);
    }
    return true;
}

bool Logging::finish()
{
    SystemLog::install(nullptr, -1);
    const bool isLogWhole = !_file || _file->flush();
    if (!isLogWhole)
        report(_path + ": the log could not be written whole");
    const bool areDiagnosticsWhole = !_diagnostics || _diagnostics->flush();
    if (!areDiagnosticsWhole)
        report(Places::diagnosticLog() + ": the diagnostic log could not be written whole");
    return isLogWhole && areDiagnosticsWhole;
}

} // namespace spectrel
