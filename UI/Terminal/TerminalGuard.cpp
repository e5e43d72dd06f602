#include "UI/Terminal/TerminalGuard.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <termios.h>
#include <unistd.h>

namespace spectrel {

namespace {

// Plain memory, set before the terminal is touched: a signal handler may read nothing else.
std::atomic<bool> isArmed {false};
termios savedModes {};
bool hasSavedModes = false;
std::array<char, 512> leavingSequence {};
std::size_t leavingLength = 0;
int savedStandardError = -1; // the real one, while its place is taken by the pipe
int heldLines = -1; // the pipe's end to read

constexpr std::array CrashSignals {SIGSEGV, SIGABRT, SIGBUS, SIGFPE, SIGILL, SIGQUIT};
std::array<struct sigaction, CrashSignals.size()> actionsBefore;
alignas(16) std::array<char, 32 * 1024> handlerStack; // a stack overflow leaves no room on the ordinary one

void writeAll(int file, const char* bytes, std::size_t count) noexcept
{
    while (count > 0) {
        const ssize_t written = ::write(file, bytes, count);
        if (written < 0 && errno == EINTR)
            continue;
        if (written <= 0)
            return;
        bytes += written;
        count -= static_cast<std::size_t>(written);
    }
}

void releaseStandardError() noexcept
{
    if (savedStandardError < 0)
        return;
    ::dup2(savedStandardError, STDERR_FILENO);
    std::array<char, 4096> lines;
    ssize_t count = 0;
    while ((count = ::read(heldLines, lines.data(), lines.size())) > 0)
        writeAll(STDERR_FILENO, lines.data(), static_cast<std::size_t>(count));
    ::close(savedStandardError);
    ::close(heldLines);
    savedStandardError = -1;
    heldLines = -1;
}

void holdStandardError()
{
    std::array<int, 2> ends {};
    if (::isatty(STDERR_FILENO) == 0 || ::pipe2(ends.data(), O_NONBLOCK | O_CLOEXEC) != 0)
        return;
    const int saved = ::fcntl(STDERR_FILENO, F_DUPFD_CLOEXEC, 3);
    if (saved < 0) {
        ::close(ends[0]);
    } else {
        heldLines = ends[0];
        savedStandardError = saved;
        ::dup2(ends[1], STDERR_FILENO);
    }
    ::close(ends[1]);
}

void handleCrash(int signal)
{
    const int error = errno;
    restoreTerminal();
    for (std::size_t index = 0; index < CrashSignals.size(); ++index) {
        if (CrashSignals[index] == signal)
            ::sigaction(signal, &actionsBefore[index], nullptr);
    }
    ::raise(signal); // delivered when this handler returns
    errno = error;
}

void installCrashHandlers()
{
    stack_t stack {};
    if (::sigaltstack(nullptr, &stack) == 0 && (stack.ss_flags & SS_DISABLE) != 0) {
        stack = {};
        stack.ss_sp = handlerStack.data();
        stack.ss_size = handlerStack.size();
        ::sigaltstack(&stack, nullptr);
    }
    struct sigaction action { };
    action.sa_handler = handleCrash;
    action.sa_flags = SA_ONSTACK;
    ::sigfillset(&action.sa_mask);
    for (std::size_t index = 0; index < CrashSignals.size(); ++index)
        ::sigaction(CrashSignals[index], &action, &actionsBefore[index]);
}

} // namespace

void restoreTerminal() noexcept
{
    if (!isArmed.exchange(false))
        return;
    const int error = errno;
    writeAll(STDOUT_FILENO, leavingSequence.data(), leavingLength);
    if (hasSavedModes)
        ::tcsetattr(STDIN_FILENO, TCSANOW, &savedModes);
    releaseStandardError();
    errno = error;
}

TerminalGuard::TerminalGuard()
{
    hasSavedModes = ::tcgetattr(STDIN_FILENO, &savedModes) == 0;
    leavingLength = 0;
    installCrashHandlers();
    static const bool isRegistered = std::atexit([] { restoreTerminal(); }) == 0;
    static_cast<void>(isRegistered);
}

TerminalGuard::~TerminalGuard()
{
    restoreTerminal();
    for (std::size_t index = 0; index < CrashSignals.size(); ++index)
        ::sigaction(CrashSignals[index], &actionsBefore[index], nullptr);
}

void TerminalGuard::setLeavingSequence(const std::string& sequence)
{
    leavingLength = std::min(sequence.size(), leavingSequence.size() - 1);
    std::memcpy(leavingSequence.data(), sequence.data(), leavingLength);
}

void TerminalGuard::arm()
{
    if (isArmed)
        return;
    holdStandardError();
    isArmed = true;
}

} // namespace spectrel
