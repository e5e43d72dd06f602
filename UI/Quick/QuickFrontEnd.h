#pragma once

#include "UI/ScreenToolkit.h"
#include "Values/Result.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>

class QQuickWindow;

namespace spectrel {

/// Light or dark, where it is not the desktop's choice.
enum class Appearance { Light, Dark };

/// The graphical screens: the toolkit of a SpectrelApp, in a window.
///
///     QGuiApplication application(argc, argv);
///     QuickFrontEnd frontEnd;
///     frontEnd.onQuit = [&runLoop] { end the run loop };
///     if (!frontEnd.start()) ...                              // before the application, which asks for the size
///     SpectrelApp app({ runLoop, clock, preferences, frontEnd.toolkit(), ... });
///     app.applicationDidFinishLaunching();                    // shows the window
///     run the run loop
///     app.applicationWillTerminate();                         // hides it
///     frontEnd.stop();
///
/// Nothing runs while nothing changes; the loading indicator turns only while it is in sight.
class QuickFrontEnd {
public:
    /// Needs the application object. `appearance` overrides the desktop's.
    explicit QuickFrontEnd(std::optional<Appearance> appearance = {});
    /// Stops.
    ~QuickFrontEnd();
    QuickFrontEnd(const QuickFrontEnd&) = delete;
    QuickFrontEnd& operator=(const QuickFrontEnd&) = delete;

    ScreenToolkit& toolkit();
    /// Loads the screens.
    Outcome start();
    /// Ends the window and all in it; any number of times.
    void stop();
    /// Brings the window to the front. `activationToken` is what a Wayland compositor gave the one who asks, or empty.
    void raise(const std::string& activationToken);
    /// Null while not started.
    QQuickWindow* window() const;

    /// The user closes the window: end the run loop, and stop after it. May be called more than once.
    std::function<void()> onQuit;

private:
    class Session;
    std::optional<Appearance> _appearance;
    std::unique_ptr<Session> _session;
};

} // namespace spectrel
