#include "Monitor/Viewing/RecordingModel.h"

#include "Monitor/DisplayState.h"
#include "Monitor/MessageText.h"

#include <algorithm>
#include <exception>
#include <limits>
#include <utility>

namespace spectrel {

namespace {

constexpr std::uint64_t AllMessages = std::numeric_limits<std::uint64_t>::max();
constexpr Playback::Time AnyTime = Playback::Time::max();
constexpr Playback::Time Tick = DisplayState::RefreshInterval;

} // namespace

RecordingModel::RecordingModel(RunLoop& runLoop, GeneratorFactory makeGenerator, SpectrelModelObserver& observer,
    ViewedClock& clock, RecordingTrack track, Report report, const Context& context)
    : _runLoop(runLoop)
    , _makeGenerator(std::move(makeGenerator))
    , _observer(observer)
    , _clock(clock)
    , _track(std::move(track))
    , _context(context)
    , _report(std::move(report))
{
    _session.emplace(_makeGenerator, false, _context);
    _session->useTechnology(_track.technology());
    _clock.set(_track.momentAt(Time::zero()));
}

void RecordingModel::restartMonitor()
{
    if (std::exchange(_isStarted, true))
        return;
    _observer.sessionDidChange();
    seekTo(Time::zero());
}

// ---- The tree

NodeRef RecordingModel::topLevelNodes()
{
    return _nodes;
}

NodeRef RecordingModel::nodeAtPath(std::string_view path)
{
    return nodeInIndex(_nodesByPath, path);
}

// ---- The wishes

void RecordingModel::play()
{
    if (isPlaying())
        return;
    _notice.clear();
    if (_time >= duration() && !_track.next())
        seekTo(Time::zero());
    _playTimer = _runLoop.repeat(PlayInterval, [this] { playOn(); });
    _observer.playbackDidChange();
}

void RecordingModel::pause()
{
    if (std::exchange(_playTimer, nullptr))
        _observer.playbackDidChange();
}

void RecordingModel::setSpeed(int speed)
{
    _speed = std::clamp(speed, 1, FastestSpeed);
    _observer.playbackDidChange();
}

void RecordingModel::seek(Time time)
{
    _notice.clear();
    seekTo(time);
}

void RecordingModel::stepMessage(Direction direction)
{
    pause();
    const bool isStepping = _isSeeking && _goal.messages != AllMessages; // the steps before are not done yet
    const std::uint64_t here = isStepping ? _goal.messages : _track.taken();
    const bool isForward = direction == Direction::Forward;
    if (isForward ? here >= messageCount() : here <= 1)
        return;
    _notice.clear();
    moveTo({AnyTime, isForward ? here + 1 : here - 1});
}

void RecordingModel::stepTick(Direction direction)
{
    pause();
    _notice.clear();
    const auto ticks = direction == Direction::Forward ? _time / Tick + 1 : (_time + Tick - Time(1)) / Tick - 1;
    seekTo(ticks * Tick);
}

// ---- The way there

void RecordingModel::playOn()
{
    if (_isSeeking)
        return; // a slow machine plays slower and leaves nothing out
    seekTo(_time + std::chrono::duration_cast<Time>(PlayInterval) * _speed);
    if (!_isSeeking && _time >= duration())
        pause();
}

void RecordingModel::seekTo(Time time)
{
    _time = std::clamp(time, Time::zero(), duration());
    moveTo({_time, AllMessages});
}

void RecordingModel::moveTo(Goal goal)
{
    _goal = goal;
    _isSeeking = true;
    const bool liesBehind = _track.taken() > goal.messages || _track.lastTime() > goal.time;
    if (liesBehind && !rewind())
        return arrive();
    work();
}

/// False when the file is no longer there; everything stays as it is.
bool RecordingModel::rewind()
{
    if (const Outcome atStart = _track.rewind(); !atStart) {
        _notice = "cannot go back: " + atStart.failure().text;
        _goal = {_track.lastTime(), _track.taken()};
        pause();
        return false;
    }
    _session.emplace(_makeGenerator, false, _context);
    _session->useTechnology(_track.technology());
    _isTreeOld = true;
    return true;
}

bool RecordingModel::hasArrived() const
{
    return !_track.next() || _track.taken() >= _goal.messages || _track.nextTime() > _goal.time;
}

void RecordingModel::work()
{
    for (std::uint64_t count = 0; count < Slice; ++count) {
        if (hasArrived())
            return arrive();
        applyNext();
    }
    _observer.playbackDidChange();
    if (std::exchange(_isWorkQueued, true))
        return;
    _runLoop.async(_lifetime.guard([this] {
        _isWorkQueued = false;
        if (_isSeeking)
            work();
    }));
}

void RecordingModel::applyNext()
{
    _isTreeOld = true;
    try {
        _session->apply(*_track.next());
    } catch (const std::exception& raised) {
        tellException("message " + std::to_string(_track.taken()) + " (" + codeText(_track.next()->body)
            + ") would have ended the program: " + exceptionName(raised));
    }
    _track.take();
}

/// Going the same way again reports nothing twice.
void RecordingModel::tellException(const std::string& line)
{
    if (_track.taken() >= _told) {
        _told = _track.taken() + 1;
        _report(line);
    }
    _notice = line;
    if (isPlaying()) {
        pause();
        _goal = {AnyTime, _track.taken() + 1};
    }
}

void RecordingModel::arrive()
{
    _isSeeking = false;
    if (_goal.messages != AllMessages)
        _time = _track.lastTime();
    if (!_track.next() && _notice.empty())
        _notice = _track.damage();
    _clock.set(_track.momentAt(_time));
    if (std::exchange(_isTreeOld, false)) {
        _nodesByPath.clear();
        _nodes = SpectrelModelNode::makeTreeFromObject(_session->display(), _nodesByPath);
        _observer.updateViewControllerFromModel(); // at once: no screen shows a place with the tree of another
    }
    _observer.playbackDidChange();
}

} // namespace spectrel
