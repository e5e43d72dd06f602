#pragma once

#include <chrono>
#include <cstdint>
#include <string>

namespace spectrel {

enum class Direction : std::int8_t { Backward = -1, Forward = 1 };

/// A recording on its own time line: where the screens stand in it, and the wishes to move.
///
/// Times count from the first message. Whoever moves need not wait: a place far away is reached step by step, and the
/// next wish may come before it is.
class Playback {
public:
    using Time = std::chrono::microseconds;
    static constexpr int FastestSpeed = 64;

    virtual ~Playback() = default;

    virtual Time duration() const = 0;
    virtual std::uint64_t messageCount() const = 0;
    /// Where the screens stand, 0 to `duration`; while seeking, where they will.
    virtual Time time() const = 0;
    /// The messages applied so far, 1 to `messageCount`.
    virtual std::uint64_t messagesApplied() const = 0;
    virtual bool isPlaying() const = 0;
    /// The place asked for is far away and not yet reached.
    virtual bool isSeeking() const = 0;
    /// How many times faster than it was recorded: 1, 2, 4, ... `FastestSpeed`.
    virtual int speed() const = 0;
    /// What went wrong lately (a message that would have ended the program, a file that is no longer there), for
    /// people; empty when nothing did.
    virtual const std::string& notice() const = 0;

    /// From the end it starts over.
    virtual void play() = 0;
    virtual void pause() = 0;
    virtual void setSpeed(int speed) = 0;
    /// A time outside the recording means its nearer end.
    virtual void seek(Time time) = 0;
    /// To just behind the next message, or back to before the last one. Pauses; at the ends nothing happens.
    virtual void stepMessage(Direction direction) = 0;
    /// To the next or the last refresh tick of the live session. Pauses.
    virtual void stepTick(Direction direction) = 0;
};

} // namespace spectrel
