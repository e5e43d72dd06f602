#pragma once

#include "Platform/RunLoop.h"

#include <chrono>
#include <functional>
#include <memory>

namespace spectrel {

/// The main queue and timers on Qt's event loop. One for a process, on its main thread.
///
/// Waits without waking up until a job, a timer or a socket is due. A queue that feeds itself does not starve timers
/// and sockets: a turn runs the jobs that were there when it began.
class QtRunLoop final : public RunLoop {
public:
    /// Makes the process's application object, unless a front end has made one of its own before. Throws
    /// `std::system_error` where the system gives no descriptors.
    QtRunLoop();
    ~QtRunLoop() override;

    void async(Job job) override;
    void after(std::chrono::nanoseconds delay, Job job) override;
    std::unique_ptr<Timer> repeat(std::chrono::nanoseconds interval, Job action) override;

    /// Turns until `quit`; returns the status given there.
    int run();
    /// Ends `run` after the current job.
    void quit(int status = 0);
    /// Turns until `done` answers true, asked after each turn; false when that took longer than `limit`.
    bool runUntil(const std::function<bool()>& done, std::chrono::nanoseconds limit);

private:
    struct Queue;
    std::unique_ptr<Queue> _queue;
};

} // namespace spectrel
