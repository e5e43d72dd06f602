#include "Monitor/Viewing/OfflineSession.h"

#include "Monitor/Snapshot.h"
#include "Monitor/SpectrelModel.h"

#include <algorithm>

namespace spectrel {

namespace {
/// Raw messages that nobody will save are let go of in lots of this size.
constexpr std::size_t RawLot = 1024 * 1024;
} // namespace

OfflineSession::OfflineSession(bool keepsHistory)
    : _keepsHistory(keepsHistory)
{
}

void OfflineSession::useTechnology(Technology technology)
{
    auto generator = LogGenerator::generatorFromTechnology(technologyConstant(technology));
    if (_generator && generator && generator->className() == _generator->className())
        return; // the session simply goes on
    _generator.replace(std::move(generator), _state, _updated);
}

void OfflineSession::apply(const RecordedMessage& message)
{
    const Moment time = _messages == 0 ? message.time : std::max(message.time, _last);
    if (_messages++ == 0)
        _first = time;
    if (_keepsHistory)
        runTicksBefore(time);
    _last = time;
    _clock.set(time);
    _updated = true;
    _generator->updateState(_state, message.body);
    _rawBytes += message.body.size();
    if (!_keepsHistory && _rawBytes > RawLot) {
        _generator->discardRawMessages();
        _rawBytes = 0;
    }
}

const Value& OfflineSession::display() const
{
    return _state[StateKey::Display];
}

/// Of the ticks up to the message only the first finds anything new; the others are idle.
void OfflineSession::runTicksBefore(Moment time)
{
    if (!_updated)
        return;
    const auto interval = std::chrono::duration_cast<std::chrono::microseconds>(SpectrelModel::RefreshInterval);
    const auto elapsed = _last - _first;
    const auto ticks = std::max<std::int64_t>(1, (elapsed + interval - std::chrono::microseconds(1)) / interval);
    const Moment tick = _first + ticks * interval;
    if (tick < time)
        refresh(tick);
}

void OfflineSession::refresh(Moment time)
{
    _clock.set(time);
    _generator->generateLogUsingState(_state);
    _updated = false;
}

bool OfflineSession::saveSnapshot(const std::string& directory, std::string& reason)
{
    if (_messages == 0) {
        reason = "there is no message to save";
        return false;
    }
    refresh(_last);
    const auto snapshot = makeSnapshot(_last, _generator->getSaveContentsFromState(_state), "");
    const std::string path = snapshotPath(directory, _last);
    if (writeSnapshot(snapshot, path, reason))
        return true;
    reason = path + ": " + reason;
    return false;
}

} // namespace spectrel
