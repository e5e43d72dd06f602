#pragma once

#include <functional>

namespace spectrel {

class DisplayState;
struct Context;

/// What a live program does when an exception that nothing catches ends it: gives the screen back, says why on standard
/// error and in the system log with the record in hexadecimal, and leaves the messages received since the last refresh
/// and the history in a snapshot file in the crash-log directory. Then the process aborts.
class Ending {
public:
    /// `restoreScreen` may be empty. The display state must live until `remove`, what the context refers to until
    /// the program ends.
    static void install(DisplayState& display, const Context& context, std::function<void()> restoreScreen);
    static void remove();

private:
    [[noreturn]] static void terminate() noexcept;
    static void tell();
    static void saveWhatIsLeft();
};

} // namespace spectrel
