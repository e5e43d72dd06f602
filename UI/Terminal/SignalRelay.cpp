#include "UI/Terminal/SignalRelay.h"

#include "UI/Terminal/TerminalGuard.h"

#include <cerrno>
#include <fcntl.h>
#include <unistd.h>

namespace spectrel {

namespace {

std::array<volatile std::sig_atomic_t, NSIG> cameIn {};
int wakeEnds[2] = {-1, -1};

bool endsProgram(int signal)
{
    return signal == SIGINT || signal == SIGTERM || signal == SIGHUP;
}

void note(int signal)
{
    const int error = errno;
    if (endsProgram(signal) && cameIn[static_cast<std::size_t>(signal)]) {
        restoreTerminal();
        struct sigaction byDefault { };
        byDefault.sa_handler = SIG_DFL;
        ::sigaction(signal, &byDefault, nullptr);
        ::raise(signal);
    }
    cameIn[static_cast<std::size_t>(signal)] = 1;
    const char wake = 0;
    // A full pipe wakes the run loop just as well.
    [[maybe_unused]] const ssize_t written = ::write(wakeEnds[1], &wake, 1);
    errno = error;
}

void handleWith(int signal, void (*handler)(int), struct sigaction* before)
{
    struct sigaction action { };
    action.sa_handler = handler;
    action.sa_flags = SA_RESTART;
    ::sigemptyset(&action.sa_mask);
    ::sigaction(signal, &action, before);
}

} // namespace

SignalRelay::SignalRelay()
{
    if (::pipe2(wakeEnds, O_NONBLOCK | O_CLOEXEC) != 0)
        wakeEnds[0] = wakeEnds[1] = -1;
    for (std::size_t index = 0; index < Signals.size(); ++index)
        ::sigaction(Signals[index], nullptr, &_before[index]);
    install();
}

SignalRelay::~SignalRelay()
{
    for (std::size_t index = 0; index < Signals.size(); ++index) {
        ::sigaction(Signals[index], &_before[index], nullptr);
        take(Signals[index]);
    }
    for (int& end : wakeEnds) {
        ::close(end);
        end = -1;
    }
}

void SignalRelay::install()
{
    for (std::size_t index = 0; index < Signals.size(); ++index) {
        // Whoever started us with a signal ignored (nohup does) wants it so.
        if (_before[index].sa_handler != SIG_IGN)
            handleWith(Signals[index], note, nullptr);
    }
}

int SignalRelay::file() const
{
    return wakeEnds[0];
}

void SignalRelay::clear() const
{
    std::array<char, 64> wakes;
    while (::read(wakeEnds[0], wakes.data(), wakes.size()) > 0) { }
}

bool SignalRelay::take(int signal)
{
    volatile std::sig_atomic_t& came = cameIn[static_cast<std::size_t>(signal)];
    const bool isSet = came != 0;
    came = 0;
    return isSet;
}

void SignalRelay::stopProcess()
{
    handleWith(SIGTSTP, SIG_DFL, nullptr);
    ::raise(SIGTSTP);
    install();
}

} // namespace spectrel
