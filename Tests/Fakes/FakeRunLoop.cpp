#include "Tests/Fakes/FakeRunLoop.h"

#include <algorithm>

namespace spectrel {

struct FakeRunLoop::RepeatingTimer final : Timer {
    RepeatingTimer(FakeRunLoop& owner, std::shared_ptr<bool> flag)
        : loop(owner)
        , alive(std::move(flag))
    {
        ++loop._timers;
    }
    ~RepeatingTimer() override
    {
        *alive = false;
        --loop._timers;
    }
    FakeRunLoop& loop;
    std::shared_ptr<bool> alive;
};

void FakeRunLoop::async(Job job)
{
    _queue.push_back(std::move(job));
}

void FakeRunLoop::schedule(std::chrono::nanoseconds when, Job job)
{
    _waiting.emplace(std::pair(when, _order++), std::move(job));
}

void FakeRunLoop::after(std::chrono::nanoseconds delay, Job job)
{
    schedule(_elapsed + delay, std::move(job));
}

void FakeRunLoop::tick(const std::shared_ptr<bool>& alive, std::chrono::nanoseconds when,
    std::chrono::nanoseconds interval, const std::shared_ptr<Job>& action)
{
    schedule(when, [this, alive, when, interval, action] {
        if (!*alive)
            return;
        (*action)();
        if (*alive)
            tick(alive, when + interval, interval, action);
    });
}

std::unique_ptr<Timer> FakeRunLoop::repeat(std::chrono::nanoseconds interval, Job action)
{
    auto alive = std::make_shared<bool>(true);
    tick(alive, _elapsed + interval, interval, std::make_shared<Job>(std::move(action)));
    return std::make_unique<RepeatingTimer>(*this, alive);
}

Moment FakeRunLoop::now() const
{
    return Start + _ahead + std::chrono::duration_cast<std::chrono::microseconds>(_elapsed);
}

ZoneState FakeRunLoop::zoneAt(Moment) const
{
    return _zone;
}

std::string FakeRunLoop::formatted(Moment moment, std::string_view pattern) const
{
    const std::string local = defaultDateForm(moment + std::chrono::seconds(_zone.secondsEastOfUTC));
    if (pattern == "'Updated' yyyy-MM-dd 'at' HH:mm:ss")
        return "Updated " + local.substr(0, 10) + " at " + local.substr(11, 8);
    return "unexpected pattern: " + std::string(pattern);
}

void FakeRunLoop::runQueued()
{
    while (!_queue.empty()) {
        const Job job = std::move(_queue.front());
        _queue.pop_front();
        job();
    }
}

void FakeRunLoop::advance(std::chrono::nanoseconds duration)
{
    const auto end = _elapsed + duration;
    runQueued();
    while (!_waiting.empty() && _waiting.begin()->first.first <= end) {
        auto due = _waiting.extract(_waiting.begin());
        _elapsed = std::max(_elapsed, due.key().first);
        due.mapped()();
        runQueued();
    }
    _elapsed = end;
}

} // namespace spectrel
