#include "Platform/SystemLog.h"

#include <cstdarg>
#include <cstdio>
#include <string>

namespace spectrel {

SystemLog* SystemLog::_installed = nullptr;
int SystemLog::_leastUrgent = -1;

void SystemLog::install(SystemLog* log, int leastUrgent)
{
    _installed = log;
    _leastUrgent = log ? leastUrgent : -1;
}

namespace detail {

void writeLogLine(int priority, const char* format, ...)
{
    char line[1024]; // longer lines are measured first, then formatted in full
    va_list arguments;
    va_start(arguments, format);
    va_list again;
    va_copy(again, arguments);
    const int length = std::vsnprintf(line, sizeof line, format, arguments);
    va_end(arguments);
    if (length >= 0 && static_cast<std::size_t>(length) < sizeof line) {
        SystemLog::installed()->write(priority, {line, static_cast<std::size_t>(length)});
    } else if (length >= 0) {
        std::string text(static_cast<std::size_t>(length) + 1, '\0');
        std::vsnprintf(text.data(), text.size(), format, again);
        text.pop_back();
        SystemLog::installed()->write(priority, text);
    }
    va_end(again);
}

} // namespace detail

void reportAssertionFailure(std::string_view fileName, int line, std::string_view text)
{
    SPECTREL_LOG(Priority::Error, "%.*s (%.*s:%d)", static_cast<int>(text.size()), text.data(),
        static_cast<int>(fileName.size()), fileName.data(), line);
}

} // namespace spectrel
