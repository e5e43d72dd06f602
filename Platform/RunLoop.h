#pragma once

#include <chrono>
#include <functional>
#include <memory>

namespace spectrel {

/// A repeating timer; destroying it stops it, also from within its own action.
class Timer {
public:
    virtual ~Timer() = default;
};

/// The main thread's queue and timers. Everything runs on one thread, one job after the other.
class RunLoop {
public:
    using Job = std::function<void()>;

    virtual ~RunLoop() = default;
    /// Runs the job after the current one has returned; jobs run in the order in which they were queued.
    virtual void async(Job job) = 0;
    /// Runs the job once, `delay` from now.
    virtual void after(std::chrono::nanoseconds delay, Job job) = 0;
    /// Runs the action every `interval`, first one interval from now. Missed ticks are not made up for.
    virtual std::unique_ptr<Timer> repeat(std::chrono::nanoseconds interval, Job action) = 0;
};

} // namespace spectrel
