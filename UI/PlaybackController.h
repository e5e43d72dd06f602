#pragma once

#include "Monitor/Playback.h"
#include "UI/KeyTable.h"

#include <chrono>
#include <string>
#include <string_view>

namespace spectrel {

/// The playback line of a recording that is browsed: what it says and what its buttons do.
///
/// The toolkit hears of every change as `ScreenPart::Playback`.
class PlaybackController {
public:
    static constexpr std::chrono::seconds SeekStep {10};

    /// `playback` outlives this.
    explicit PlaybackController(Playback& playback)
        : _playback(playback)
    {
    }

    bool isPlaying() const
    {
        return _playback.isPlaying();
    }
    bool isAtEnd() const;
    /// How far along the time line, 0 to 1.
    double fraction() const;
    /// "paused", "playing", "playing 4x", "seeking" or "at the end".
    std::string stateText() const;
    /// The time from the first message and the whole length: "00:12.345 / 01:29.950", with hours where there are any.
    std::string timeText() const;
    /// "message 412 of 1830".
    std::string messagesText() const;
    /// What went wrong lately; empty when nothing did.
    const std::string& notice() const
    {
        return _playback.notice();
    }

    /// A key of the time line; false when it is none.
    bool press(std::string_view key, KeyTaker taker);
    void togglePlaying();
    void stepMessage(Direction direction)
    {
        _playback.stepMessage(direction);
    }
    void stepTick(Direction direction)
    {
        _playback.stepTick(direction);
    }
    /// Ten seconds of the recording.
    void seekStep(Direction direction);
    /// `fraction` of the time line; below 0 and above 1 mean its ends.
    void seekToFraction(double fraction);
    /// Twice as fast or half as fast, from 1 to 64 times the recording's own speed.
    void changeSpeed(Direction direction);

private:
    void perform(KeyAction action, std::string_view key);

    Playback& _playback;
};

} // namespace spectrel
