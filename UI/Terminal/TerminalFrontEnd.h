#pragma once

#include "Platform/Lifetime.h"
#include "Platform/RunLoop.h"
#include "UI/ScreenToolkit.h"
#include "Values/Result.h"

#include <functional>
#include <memory>
#include <string>

namespace spectrel {

/// The terminal screens: the toolkit of a SpectrelApp, attached to the real terminal and the run loop.
///
///     TerminalFrontEnd frontEnd(runLoop);
///     frontEnd.onQuit = [&runLoop] { end the run loop };
///     if (!frontEnd.start()) ...                              // before the application, which asks for the size
///     SpectrelApp app({ runLoop, clock, preferences, frontEnd.toolkit(), ... });
///     app.applicationDidFinishLaunching();
///     run the run loop
///     app.applicationWillTerminate();
///     frontEnd.stop();
///
/// Standard error is held back while the screens are open and let out when they close. A terminate handler calls
/// `restoreTerminal` (TerminalGuard.h) before it writes. Nothing runs while nothing changes; a timer runs only while a
/// loading indicator spins.
class TerminalFrontEnd {
public:
    /// The run loop must be the application's event loop (a QCoreApplication exists by `start`) and outlive this.
    explicit TerminalFrontEnd(RunLoop& runLoop);
    /// Stops.
    ~TerminalFrontEnd();
    TerminalFrontEnd(const TerminalFrontEnd&) = delete;
    TerminalFrontEnd& operator=(const TerminalFrontEnd&) = delete;

    ScreenToolkit& toolkit();
    /// Opens the screens and takes SIGINT, SIGTERM, SIGHUP (each calls `onQuit`), SIGWINCH, SIGTSTP and SIGCONT; fails
    /// when there is no terminal that could show them.
    Outcome start();
    /// Gives the terminal and the signals back; any number of times.
    void stop();

    /// The user wants to leave, or the terminal is gone: end the run loop, and stop after it. May be called more than
    /// once.
    std::function<void()> onQuit;

private:
    class Session;
    void quit() const;
    void copy(const std::string& text);
    void needsDisplay();

    RunLoop& _runLoop;
    Lifetime _lifetime; // of drawing jobs on the queue
    bool _isDrawingQueued = false;
    class Screens;
    std::unique_ptr<Screens> _screens;
    std::unique_ptr<Session> _session; // while started
};

} // namespace spectrel
