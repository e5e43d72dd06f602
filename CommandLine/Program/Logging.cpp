#include "CommandLine/Program/Logging.h"

#include "CommandLine/Program/ErrorLine.h"
#include "Platform/Places.h"

namespace spectrel {

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
    } else if (use == Use::Live) {
        _system = std::make_unique<SyslogLog>();
    }
    return true;
}

SystemLog& Logging::log() const
{
    if (_file)
        return *_file;
    return _system ? static_cast<SystemLog&>(*_system) : SystemLog::none();
}

bool Logging::finish()
{
    if (!_file || _file->flush())
        return true;
    report(_path + ": the log could not be written whole");
    return false;
}

} // namespace spectrel
