#pragma once

#include "Platform/Context.h"

#include <string>

namespace spectrel {

/// A system log and a console that keep what comes, as text: "<3>line\n".
class LogRecorder final : public SystemLog, public Console {
public:
    explicit LogRecorder(int leastUrgent = 7);
    /// One in which it is both.
    Context context()
    {
        return {.log = *this, .console = *this};
    }

    void write(int priority, std::string_view text) override;
    void line(std::string_view text) override;

    /// What was logged since the last call.
    std::string takeLog();
    /// Only the lines that hold the part, since the last call.
    std::string takeLogWith(std::string_view part);
    /// What went to the console since the last call.
    std::string takeConsole();

private:
    std::string _log;
    std::string _console;
};

} // namespace spectrel
