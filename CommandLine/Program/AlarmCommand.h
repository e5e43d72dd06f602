#pragma once

#include "Values/Result.h"

#include <deque>
#include <string>
#include <string_view>
#include <sys/types.h>

namespace spectrel {

/// Runs a command of the shell, each time with a line on its standard input, beside the program.
class AlarmCommand {
public:
    /// So many at once: one more waits for the one that has run longest.
    static constexpr std::size_t MaxRunning = 8;

    explicit AlarmCommand(std::string command)
        : _command(std::move(command))
    {
    }
    /// Waits for those that still run.
    ~AlarmCommand();
    AlarmCommand(const AlarmCommand&) = delete;
    AlarmCommand& operator=(const AlarmCommand&) = delete;

    /// Starts it; what becomes of it is its own affair. The line has less than a pipe takes at once (4096 bytes).
    Outcome run(std::string_view line);

private:
    Outcome start(int input);
    void forgetFinished();

    std::string _command;
    std::deque<pid_t> _running;
};

} // namespace spectrel
