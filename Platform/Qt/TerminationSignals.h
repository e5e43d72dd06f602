#pragma once

#include <functional>
#include <initializer_list>
#include <memory>

namespace spectrel {

/// Turns SIGINT, SIGTERM and SIGHUP into a call on the main queue; the signals' former actions return with the object's
/// end. The second of them ends the process at once, whatever it is busy with. At most one object at a time; needs the
/// application object. Throws `std::system_error` where the system gives no descriptors.
class TerminationSignals {
public:
    using Handler = std::function<void(int signal)>;

    /// `further`: more signals to be turned into calls.
    explicit TerminationSignals(Handler handler, std::initializer_list<int> further = {});
    ~TerminationSignals();
    TerminationSignals(const TerminationSignals&) = delete;
    TerminationSignals& operator=(const TerminationSignals&) = delete;

private:
    struct Private;
    std::unique_ptr<Private> _private;
};

} // namespace spectrel
