#pragma once

#include <functional>
#include <memory>

namespace spectrel {

/// Turns SIGINT, SIGTERM and SIGHUP into a call on the main queue; the signals' former actions return with the object's
/// end. At most one at a time; needs the application object.
class TerminationSignals {
public:
    using Handler = std::function<void(int signal)>;

    explicit TerminationSignals(Handler handler);
    ~TerminationSignals();
    TerminationSignals(const TerminationSignals&) = delete;
    TerminationSignals& operator=(const TerminationSignals&) = delete;

private:
    struct Private;
    std::unique_ptr<Private> _private;
};

} // namespace spectrel
