#pragma once

#include "Platform/Clock.h"
#include "Platform/RunLoop.h"

#include <cstdint>
#include <deque>
#include <map>
#include <string>
#include <utility>

namespace spectrel {

/// Virtual time: a clock and a run loop that move only when told.
class FakeRunLoop final : public RunLoop, public Clock {
public:
    static constexpr Moment Start {std::chrono::microseconds(1'709'647'651'000'000)}; // 2024-03-05 14:07:31 +0000

    void async(Job job) override;
    void after(std::chrono::nanoseconds delay, Job job) override;
    std::unique_ptr<Timer> repeat(std::chrono::nanoseconds interval, Job action) override;

    Moment now() const override;
    std::chrono::nanoseconds steady() const override
    {
        return _elapsed;
    }
    ZoneState zoneAt(Moment moment) const override;
    std::string formatted(Moment moment, std::string_view pattern) const override;

    /// Runs what is queued, and what that queues, without moving the time.
    void runQueued();
    /// Moves the time on, running what falls due at its own moment.
    void advance(std::chrono::nanoseconds duration);

    /// Sets the clock, ahead or back; intervals go on.
    void setClock(std::chrono::seconds ahead)
    {
        _ahead += ahead;
    }
    void setZone(ZoneState zone)
    {
        _zone = zone;
    }
    std::size_t waitingJobs() const
    {
        return _waiting.size();
    }
    /// Timers that are alive.
    std::size_t timers() const
    {
        return _timers;
    }

private:
    struct RepeatingTimer;
    void schedule(std::chrono::nanoseconds when, Job job);
    void tick(const std::shared_ptr<bool>& alive, std::chrono::nanoseconds when, std::chrono::nanoseconds interval,
        const std::shared_ptr<Job>& action);

    std::chrono::nanoseconds _elapsed {0};
    std::chrono::seconds _ahead {0}; // of the wall clock, as it was set
    ZoneState _zone;
    std::deque<Job> _queue;
    std::map<std::pair<std::chrono::nanoseconds, std::uint64_t>, Job> _waiting; // by due time, then by order
    std::uint64_t _order = 0;
    std::size_t _timers = 0;
};

} // namespace spectrel
