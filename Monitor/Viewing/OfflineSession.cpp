#include "Monitor/Viewing/OfflineSession.h"

#include "Monitor/Snapshot.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {
/// Raw messages that nobody will save are let go of in lots of this size.
constexpr std::size_t RawLot = 1024 * 1024;
} // namespace

OfflineSession::OfflineSession(GeneratorFactory makeGenerator, bool keepsHistory, const Context& context)
    : _keepsHistory(keepsHistory)
    , _display(
          std::move(makeGenerator), {_clock, context.resources, context.log, context.console, context.diagnosticLog})
{
}

void OfflineSession::useTechnology(Technology technology)
{
    _display.useTechnology(technologyConstant(technology), DisplayState::SameClass::GoesOn);
}

void OfflineSession::apply(const RecordedMessage& message)
{
    const Moment time = _messages == 0 ? message.time : std::max(message.time, _last);
    if (_messages++ == 0) {
        _first = time;
        _nextTick = time + DisplayState::RefreshInterval;
    }
    if (_onTick)
        passTicksBefore(time);
    if (_keepsHistory)
        runTicksBefore(time);
    _last = time;
    _clock.set(time);
    try {
        _display.apply(message.body, time);
    } catch (...) {
        _display.finishMessage();
        throw;
    }
    _rawBytes += message.body.size();
    if (!_keepsHistory && _rawBytes > RawLot) {
        _display.generator()->discardRawMessages();
        _rawBytes = 0;
    }
}

/// Of the ticks up to the message only the first finds anything new; the others are idle.
void OfflineSession::runTicksBefore(Moment time)
{
    if (!_display.hasNews())
        return;
    const auto interval = std::chrono::duration_cast<std::chrono::microseconds>(DisplayState::RefreshInterval);
    const auto elapsed = _last - _first;
    const auto ticks = std::max<std::int64_t>(1, (elapsed + interval - std::chrono::microseconds(1)) / interval);
    const Moment tick = _first + ticks * interval;
    if (tick < time)
        refresh(tick);
}

void OfflineSession::passTicksBefore(Moment time)
{
    constexpr std::chrono::microseconds Interval = DisplayState::RefreshInterval;
    for (; _nextTick < time && _nextTick - _last <= LongestPause; _nextTick += Interval)
        _onTick(_nextTick);
    if (_nextTick < time)
        _nextTick += (time - _nextTick + Interval - std::chrono::microseconds(1)) / Interval * Interval;
}

void OfflineSession::refresh(Moment time)
{
    _clock.set(time);
    _display.build();
    _display.takeNews();
}

Outcome OfflineSession::saveSnapshot(const std::string& directory)
{
    if (_messages == 0)
        return Failure {"there is no message to save"};
    refresh(_last);
    const auto snapshot = makeSnapshot(_last, _display.saveContents(), "");
    const std::string path = snapshotPath(directory, _last);
    std::string reason;
    if (!writeSnapshot(snapshot, path, reason))
        return Failure {path + ": " + reason};
    return Done {};
}

} // namespace spectrel
