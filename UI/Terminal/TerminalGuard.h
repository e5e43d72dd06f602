#pragma once

#include <string>

namespace spectrel {

/// Gives the terminal back as it was before the screens were opened, and lets out what was written to standard error
/// meanwhile. Safe at any time and any number of times, in signal and terminate handlers too; it does nothing when no
/// screen is open.
void restoreTerminal() noexcept;

/// Keeps what `restoreTerminal` needs while the screens are open.
///
/// While armed, standard error (when it is a terminal) is held in a pipe, so that lines do not run across the screen;
/// the first 64 KiB are kept. A crash (SIGSEGV, SIGABRT, SIGBUS, SIGFPE, SIGILL, SIGQUIT) restores the terminal before
/// the signal takes its course.
class TerminalGuard {
public:
    TerminalGuard();
    ~TerminalGuard();
    TerminalGuard(const TerminalGuard&) = delete;
    TerminalGuard& operator=(const TerminalGuard&) = delete;

    /// What ends the drawing on this terminal; at most 511 bytes are kept.
    static void setLeavingSequence(const std::string& sequence);
    /// From now on there is something to give back.
    static void arm();
};

} // namespace spectrel
