#pragma once

#include <cstdint>
#include <string_view>

namespace spectrel {

/// syslog(3) priorities that the system uses.
namespace Priority {
constexpr int Error = 3; // LOG_ERR: failures
constexpr int Warning = 4; // LOG_WARNING: traces, such as the name that each section logs on every call
constexpr int SnapshotWriter = 16; // the raw value that the DLF writer passes; kept as it is
} // namespace Priority

/// Where diagnostics go: the platform's system log, a file, or a test's recorder.
class SystemLog {
public:
    virtual ~SystemLog() = default;
    /// `priority` is the raw syslog value; `text` may hold any bytes.
    virtual void write(int priority, std::string_view text) = 0;

    /// Installs the log that `logLine` writes to (null: none) and the least urgent severity (0 to 7) that is wanted;
    /// -1 wants nothing. The log must outlive its installation.
    static void install(SystemLog* log, int leastUrgent);
    static SystemLog* installed()
    {
        return _installed;
    }
    static int leastUrgent()
    {
        return _leastUrgent;
    }

    /// Whether lines of this priority are wanted; the severity is its low three bits. Ask before costly formatting.
    static bool wants(int priority)
    {
        return (priority & 7) <= _leastUrgent;
    }

private:
    static SystemLog* _installed;
    static int _leastUrgent;
};

namespace detail {
void writeLogLine(int priority, const char* format, ...) __attribute__((format(printf, 2, 3)));
}

/// Writes one printf-formatted line; costs one comparison when nobody wants it.
#define SPECTREL_LOG(priority, ...)                                                                                    \
    do {                                                                                                               \
        if (::spectrel::SystemLog::wants(priority))                                                                    \
            ::spectrel::detail::writeLogLine(priority, __VA_ARGS__);                                                   \
    } while (false)

/// Reports an assertion failure (priority 3: text, file name, line); processing goes on.
void reportAssertionFailure(std::string_view fileName, int line, std::string_view text);

} // namespace spectrel
