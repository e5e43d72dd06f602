#include "Monitor/Viewing/RecordingTrack.h"

#include <algorithm>
#include <utility>

namespace spectrel {

std::optional<RecordingTrack> RecordingTrack::open(std::string path, std::unique_ptr<RecordingReader> reader,
    std::optional<Technology> technology, std::string& reason)
{
    if (reader->technology())
        technology = reader->technology();
    if (!technology) {
        reason = "does not tell its technology; name it with --technology";
        return std::nullopt;
    }
    RecordingTrack track(std::move(path), *technology);
    track.measure(*reader);
    if (track._messageCount == 0) {
        reason = track._damage.empty() ? "the recording holds no message" : track._damage;
        return std::nullopt;
    }
    if (!track.rewind(reason))
        return std::nullopt;
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

bool RecordingTrack::rewind(std::string& reason)
{
    auto opened = openRecording(_path);
    if (!opened) {
        reason = opened.failure().text;
        return false;
    }
    _reader = *std::move(opened);
    _taken = 0;
    _lastTime = {};
    readNext();
    return true;
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
