#pragma once

#include "Platform/Syslog/DiagnosticFile.h"
#include "Platform/Syslog/FileLog.h"
#include "Platform/Syslog/SyslogLog.h"

#include <memory>
#include <optional>
#include <string>

namespace spectrel {

/// Chooses where log lines go: to a file every one of them; otherwise, for a live session, the urgent ones to the
/// system log. Diagnostic lines go to their own file, where the environment names one. Failures are told on standard
/// error.
class Logging {
public:
    enum class Use { Live, Offline };

    bool start(const std::optional<std::string>& file, Use use);
    /// What was chosen; nobody's before `start`. They live as long as this.
    SystemLog& log() const;
    DiagnosticLog* diagnostics() const
    {
        return _diagnostics.get();
    }
    /// False when a line could not be written.
    bool finish();

private:
    bool startDiagnostics();
    bool startLog(const std::optional<std::string>& file, Use use);

    std::string _path;
    std::unique_ptr<DiagnosticFile> _diagnostics;
    std::unique_ptr<FileLog> _file;
    std::unique_ptr<SyslogLog> _system;
};

} // namespace spectrel
