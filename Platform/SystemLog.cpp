#include "Platform/SystemLog.h"

#include <cstdarg>
#include <cstdio>
#include <string>

namespace spectrel {

namespace {

class NoLog final : public SystemLog {
public:
    NoLog()
        : SystemLog(NoPriority)
    {
    }
    void write(int, std::string_view) override { }
};

NoLog noLog;

} // namespace

SystemLog& SystemLog::none()
{
    return noLog;
}

namespace detail {

void writeLogLine(SystemLog& log, int priority, const char* format, ...)
{
    char line[1024]; // longer lines are measured first, then formatted in full
    va_list arguments;
    va_start(arguments, format);
    va_list again;
    va_copy(again, arguments);
    const int length = std::vsnprintf(line, sizeof line, format, arguments);
    va_end(arguments);
    if (length >= 0 && static_cast<std::size_t>(length) < sizeof line) {
        log.write(priority, {line, static_cast<std::size_t>(length)});
    } else if (length >= 0) {
        std::string text(static_cast<std::size_t>(length) + 1, '\0');
        std::vsnprintf(text.data(), text.size(), format, again);
        text.pop_back();
        log.write(priority, text);
    }
    va_end(again);
}

} // namespace detail

void reportAssertionFailure(SystemLog& log, std::string_view fileName, int line, std::string_view text)
{
    SPECTREL_LOG(log, Priority::Error, "%.*s (%.*s:%d)", static_cast<int>(text.size()), text.data(),
        static_cast<int>(fileName.size()), fileName.data(), line);
}

} // namespace spectrel
