#include "CommandLine/Program/AlarmCommand.h"

#include <array>
#include <cerrno>
#include <climits>
#include <csignal>
#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace spectrel {

namespace {

/// Whether the process has ended; waits for that, or not.
bool hasEnded(pid_t process, int options)
{
    int status = 0;
    pid_t answer = 0;
    do
        answer = ::waitpid(process, &status, options);
    while (answer < 0 && errno == EINTR);
    return answer != 0;
}

} // namespace

AlarmCommand::~AlarmCommand()
{
    for (const pid_t process : _running)
        hasEnded(process, 0);
}

Outcome AlarmCommand::run(std::string_view line)
{
    forgetFinished();
    std::array<int, 2> ends {};
    if (::pipe2(ends.data(), O_CLOEXEC) != 0)
        return Failure::ofSystem();
    // Written before anybody reads, so that a command that reads nothing breaks no pipe.
    const std::string text = std::string(line.substr(0, PIPE_BUF - 1)) + "\n";
    const bool isWritten = ::write(ends[1], text.data(), text.size()) == static_cast<ssize_t>(text.size());
    Outcome outcome = isWritten ? start(ends[0]) : Outcome(Failure::ofSystem());
    ::close(ends[0]);
    ::close(ends[1]);
    return outcome;
}

Outcome AlarmCommand::start(int input)
{
    posix_spawn_file_actions_t actions;
    ::posix_spawn_file_actions_init(&actions);
    ::posix_spawn_file_actions_adddup2(&actions, input, STDIN_FILENO);
    posix_spawnattr_t attributes;
    ::posix_spawnattr_init(&attributes);
    sigset_t usual; // signals that the program ignores are the command's again
    ::sigemptyset(&usual);
    ::sigaddset(&usual, SIGPIPE);
    ::sigaddset(&usual, SIGXFSZ);
    ::posix_spawnattr_setsigdefault(&attributes, &usual);
    ::posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGDEF);
    std::string shell = "sh";
    std::string option = "-c";
    std::array<char*, 4> words {shell.data(), option.data(), _command.data(), nullptr};
    pid_t process = 0;
    const int error = ::posix_spawn(&process, "/bin/sh", &actions, &attributes, words.data(), environ);
    ::posix_spawn_file_actions_destroy(&actions);
    ::posix_spawnattr_destroy(&attributes);
    if (error != 0)
        return Failure::ofSystem(error);
    _running.push_back(process);
    return Done();
}

void AlarmCommand::forgetFinished()
{
    std::erase_if(_running, [](pid_t process) { return hasEnded(process, WNOHANG); });
    if (_running.size() < MaxRunning)
        return;
    hasEnded(_running.front(), 0);
    _running.pop_front();
}

} // namespace spectrel
