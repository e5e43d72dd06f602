#pragma once

#include "Platform/Syslog/FileLog.h"
#include "Platform/Syslog/SyslogLog.h"

#include <memory>
#include <optional>
#include <string>

namespace spectrel {

/// Chooses where log lines go: to a file every one of them; otherwise, for a live session, the urgent ones to the
/// system log. Failures are told on standard error.
class Logging {
public:
    enum class Use { Live, Offline };

    bool start(const std::optional<std::string>& file, Use use);
    /// False when a line could not be written.
    bool finish();

private:
    std::string _path;
    std::unique_ptr<FileLog> _file;
    std::unique_ptr<SyslogLog> _system;
};

} // namespace spectrel
