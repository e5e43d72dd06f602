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

    /// Whether lines of this priority are wanted; the severity is its low three bits. Ask before costly formatting.
    bool wants(int priority) const
    {
        return (priority & 7) <= _leastUrgent;
    }
    /// Wants nothing.
    static SystemLog& none();

protected:
    static constexpr int EveryPriority = 7;
    static constexpr int NoPriority = -1;

    /// `leastUrgent`: the least urgent severity (0 to 7) that is wanted, or `NoPriority`.
    explicit SystemLog(int leastUrgent)
        : _leastUrgent(leastUrgent)
    {
    }

private:
    int _leastUrgent;
};

namespace detail {
void writeLogLine(SystemLog& log, int priority, const char* format, ...) __attribute__((format(printf, 3, 4)));
}

/// Writes one printf-formatted line to the `SystemLog` that `log` names; costs one comparison when nobody wants it.
#define SPECTREL_LOG(log, priority, ...)                                                                               \
    do {                                                                                                               \
        if ((log).wants(priority))                                                                                     \
            ::spectrel::detail::writeLogLine((log), (priority), __VA_ARGS__);                                          \
    } while (false)

/// Reports an assertion failure (priority 3: text, file name, line); processing goes on.
void reportAssertionFailure(SystemLog& log, std::string_view fileName, int line, std::string_view text);

} // namespace spectrel
