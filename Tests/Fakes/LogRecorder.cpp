#include "Tests/Fakes/LogRecorder.h"

#include <utility>

namespace spectrel {

LogRecorder::LogRecorder(int leastUrgent)
    : SystemLog(leastUrgent)
{
}

void LogRecorder::write(int priority, std::string_view text)
{
    _log += "<" + std::to_string(priority) + ">" + std::string(text) + "\n";
}

void LogRecorder::line(std::string_view text)
{
    _console += std::string(text) + "\n";
}

std::string LogRecorder::takeLog()
{
    return std::exchange(_log, {});
}

std::string LogRecorder::takeLogWith(std::string_view part)
{
    std::string found;
    const std::string log = takeLog();
    for (std::size_t start = 0; start < log.size();) {
        const std::size_t end = log.find('\n', start) + 1;
        const std::string line = log.substr(start, end - start);
        if (line.find(part) != std::string::npos)
            found += line;
        start = end;
    }
    return found;
}

std::string LogRecorder::takeConsole()
{
    return std::exchange(_console, {});
}

} // namespace spectrel
