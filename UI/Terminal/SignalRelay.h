#pragma once

#include <array>
#include <csignal>

namespace spectrel {

/// Brings signals onto the run loop: while one lives, SIGINT, SIGTERM, SIGHUP, SIGWINCH, SIGTSTP and SIGCONT make
/// `file` readable and are then taken one by one. When the run loop does not get to a wish to end before the next one
/// comes, the program ends at once, with the terminal restored. One at a time.
class SignalRelay {
public:
    SignalRelay();
    ~SignalRelay();
    SignalRelay(const SignalRelay&) = delete;
    SignalRelay& operator=(const SignalRelay&) = delete;

    /// -1 when there is none: no signal will be reported.
    int file() const;
    /// Empties `file`; before the signals are taken.
    void clear() const;
    /// Whether the signal came since it was last taken.
    static bool take(int signal);
    /// Takes the handlers anew, from whoever has replaced them.
    void install();
    /// Stops the process as the terminal's stop key does without a handler; returns when it goes on.
    void stopProcess();

private:
    static constexpr std::array Signals {SIGINT, SIGTERM, SIGHUP, SIGWINCH, SIGTSTP, SIGCONT};
    std::array<struct sigaction, Signals.size()> _before;
};

} // namespace spectrel
