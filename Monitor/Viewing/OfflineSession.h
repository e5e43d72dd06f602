#pragma once

#include "Monitor/DisplayState.h"
#include "Monitor/Viewing/RecordingClock.h"
#include "Records/Recording.h"
#include "Values/Result.h"
#include "Values/Value.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>

namespace spectrel {

/// Applies recorded messages as a live session would, on the recording's own clock.
///
/// Refresh ticks fall 2.0 s, 4.0 s, ... after the first message; a message at the very time of a tick comes before it.
class OfflineSession {
public:
    /// `keepsHistory`: run the refresh ticks and keep the raw messages, as a snapshot needs them; otherwise the raw
    /// messages are forgotten, so that memory does not grow with the recording. The clock of the context does not
    /// count.
    OfflineSession(GeneratorFactory makeGenerator, bool keepsHistory, const Context& context);
    OfflineSession(const OfflineSession&) = delete;
    OfflineSession& operator=(const OfflineSession&) = delete;

    /// In a pause of the recording that is longer than this the ticks end until the next message.
    static constexpr std::chrono::minutes LongestPause {10};

    /// Hears of each refresh tick at which the display stands as it was then.
    using TickHandler = std::function<void(Moment tick)>;
    void setTickHandler(TickHandler handler)
    {
        _onTick = std::move(handler);
    }

    /// A recording of another technology replaces the generator, as a baseband that changes its technology does.
    void useTechnology(Technology technology);
    /// Passes on what the message raises.
    void apply(const RecordedMessage& message);
    /// When the last message came.
    Moment lastTime() const
    {
        return _last;
    }
    std::uint64_t messages() const
    {
        return _messages;
    }
    /// The display as it stands; absent when there is none.
    const Value& display() const
    {
        return _display.display();
    }
    DisplayState& displayState()
    {
        return _display;
    }

    /// Refreshes once more and writes the snapshot file, both at the last message's time.
    Outcome saveSnapshot(const std::string& directory);

private:
    void runTicksBefore(Moment time);
    void refresh(Moment time);
    void passTicksBefore(Moment time);

    bool _keepsHistory;
    RecordingClock _clock;
    DisplayState _display;
    std::uint64_t _messages = 0;
    std::size_t _rawBytes = 0; // kept by the generator since it last let go of them
    Moment _first {};
    Moment _last {};
    Moment _nextTick {};
    TickHandler _onTick;
};

} // namespace spectrel
