#pragma once

#include "Monitor/Playback.h"
#include "Records/Recording.h"
#include "Values/Result.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace spectrel {

/// A recording as a track: read through once for its length, then taken message by message, from the start again as
/// often as wanted. Memory does not grow with it.
///
/// Each message has its time on the track, which counts from the first message and never runs backwards. A recording
/// whose messages all carry one time (a DLF file has no times) runs at ten messages a second.
class RecordingTrack {
public:
    using Time = Playback::Time;
    static constexpr Time StepWithoutTimes {std::chrono::milliseconds(100)};

    /// Takes a reader that has just opened the file at `path`, which must be there for as long as the track is used.
    /// `technology` counts where the file names none. Fails when the technology stays open or there is not one
    /// message.
    static Result<RecordingTrack> open(
        std::string path, std::unique_ptr<RecordingReader> reader, std::optional<Technology> technology);

    Technology technology() const
    {
        return _technology;
    }
    /// When that was; a recording without times shows only when it was made.
    Moment momentAt(Time time) const
    {
        return _hasTimes ? _start + time : _start;
    }
    Time duration() const
    {
        return _duration;
    }
    std::uint64_t messageCount() const
    {
        return _messageCount;
    }
    /// What ended the reading early; empty when the file is whole.
    const std::string& damage() const
    {
        return _damage;
    }

    /// The message in front, valid until it is taken; null at the end.
    const RecordedMessage* next() const
    {
        return _hasNext ? &_next : nullptr;
    }
    /// The time on the track of the message in front, and of the one taken last (0 before the first).
    Time nextTime() const
    {
        return _nextTime;
    }
    Time lastTime() const
    {
        return _lastTime;
    }
    std::uint64_t taken() const
    {
        return _taken;
    }
    void take();
    /// Back to the start. Fails when the file cannot be opened any more; the track stays where it is.
    Outcome rewind();

private:
    RecordingTrack(std::string path, Technology technology)
        : _path(std::move(path))
        , _technology(technology)
    {
    }
    void measure(RecordingReader& reader);
    void readNext();

    std::string _path;
    Technology _technology;
    Moment _start {};
    Time _duration {};
    std::uint64_t _messageCount = 0;
    bool _hasTimes = false;
    std::string _damage;

    std::unique_ptr<RecordingReader> _reader;
    RecordedMessage _next {};
    bool _hasNext = false;
    Time _nextTime {};
    Time _lastTime {};
    std::uint64_t _taken = 0;
};

} // namespace spectrel
