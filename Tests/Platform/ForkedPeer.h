#pragma once

#include <functional>
#include <sys/types.h>

namespace spectrel {

/// A second process for a test, and a pair of pipes to order what the two do.
class ForkedPeer {
public:
    /// Runs `body` in a child, which then ends with the returned status.
    explicit ForkedPeer(const std::function<int(ForkedPeer&)>& body);
    /// Kills the child if it still runs.
    ~ForkedPeer();
    ForkedPeer(const ForkedPeer&) = delete;
    ForkedPeer& operator=(const ForkedPeer&) = delete;

    /// Lets the other side go on.
    void signal();
    /// Waits until the other side signals; false when it ended without.
    bool await();

    /// Waits for the child's end; its status.
    int finish();
    /// Ends the child at once, as a crash would.
    void kill();

private:
    pid_t _child = -1;
    int _reading = -1;
    int _writing = -1;
};

} // namespace spectrel
