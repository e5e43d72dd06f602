#pragma once

#include "Monitor/Playback.h"

#include <string>

namespace spectrel {

/// A time line whose state the test sets; it writes down what was asked of it.
class FakePlayback final : public Playback {
public:
    Time duration() const override
    {
        return length;
    }
    std::uint64_t messageCount() const override
    {
        return count;
    }
    Time time() const override
    {
        return here;
    }
    std::uint64_t messagesApplied() const override
    {
        return applied;
    }
    bool isPlaying() const override
    {
        return plays;
    }
    bool isSeeking() const override
    {
        return seeks;
    }
    int speed() const override
    {
        return speedNow;
    }
    const std::string& notice() const override
    {
        return noticeNow;
    }
    void play() override
    {
        calls += "play ";
        plays = true;
    }
    void pause() override
    {
        calls += "pause ";
        plays = false;
    }
    void setSpeed(int speed) override
    {
        calls += "speed " + std::to_string(speed) + " ";
        speedNow = speed;
    }
    void seek(Time time) override
    {
        calls += "seek " + std::to_string(time.count() / 1000) + " ";
    }
    void stepMessage(Direction direction) override
    {
        calls += direction == Direction::Forward ? "message+ " : "message- ";
    }
    void stepTick(Direction direction) override
    {
        calls += direction == Direction::Forward ? "tick+ " : "tick- ";
    }

    Time length = std::chrono::seconds(90);
    Time here {};
    std::uint64_t count = 100;
    std::uint64_t applied = 1;
    bool plays = false;
    bool seeks = false;
    int speedNow = 1;
    std::string noticeNow;
    std::string calls; // times in milliseconds
};

} // namespace spectrel
