#include "Monitor/Viewing/RecordingTrack.h"

#include <algorithm>
#include <utility>

namespace spectrel {

Result<RecordingTrack> RecordingTrack::open(
    std::string path, std::unique_ptr<RecordingReader> reader, std::optional<Technology> technology)
{
    if (reader->technology())
        technology = reader->technology();
    if (!technology)
        return Failure {"does not tell its technology; name it with --technology"};
    RecordingTrack track(std::move(path), *technology);
    track.measure(*reader);
    if (track._messageCount == 0)
        return Failure {track._damage.empty() ? "the recording holds no message" : track._damage};
    if (const Outcome atStart = track.rewind(); !atStart)
        return atStart.failure();
    return track;
}

/// Reads to the end, without decoding anything.
void RecordingTrack::measure(RecordingReader& reader)
{
    RecordedMessage message;
    while (reader.next(message)) {
        if (_messageCount++ == 0)
            _start = message.time;
        _duration = std::max<Time>(_duration, message.time - _start);
    }
    _damage = reader.damage();
    _hasTimes = _duration > Time::zero();
    if (!_hasTimes && _messageCount > 0)
        _duration = static_cast<std::int64_t>(_messageCount - 1) * StepWithoutTimes;
}

Outcome RecordingTrack::rewind()
{
    auto opened = openRecording(_path);
    if (!opened)
        return opened.failure();
    _reader = *std::move(opened);
    _taken = 0;
    _lastTime = {};
    readNext();
    return Done {};
}

void RecordingTrack::take()
{
    _lastTime = _nextTime;
    ++_taken;
    readNext();
}

/// A file that has grown meanwhile ends where it was measured to.
void RecordingTrack::readNext()
{
    _hasNext = _taken < _messageCount && _reader->next(_next);
    if (!_hasNext)
        return;
    const Time time = _hasTimes ? Time(_next.time - _start) : static_cast<std::int64_t>(_taken) * StepWithoutTimes;
    _nextTime = std::clamp(time, _lastTime, std::max(_lastTime, _duration));
}

} // namespace spectrel
