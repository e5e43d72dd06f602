#pragma once

#include "Monitor/MonitorModel.h"
#include "Monitor/SpectrelModel.h"
#include "Monitor/Viewing/OfflineSession.h"
#include "Monitor/Viewing/RecordingTrack.h"
#include "Monitor/Viewing/ViewedClock.h"
#include "Platform/Lifetime.h"
#include "Platform/RunLoop.h"

#include <chrono>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// The model of a recording that is browsed: the display as it was at the place on the time line.
///
/// The state of a decoder cannot be taken back, so a place behind is reached from the start again: that costs the
/// decoding of all before it and no memory. Long ways are gone in slices on the run loop; the tree changes on arrival.
///
/// A message that would end the running application is reported (`report`, `notice`) and left behind; while playing it
/// also pauses, so that the moment can be looked at.
class RecordingModel final : public MonitorModel, public Playback {
public:
    using Report = std::function<void(const std::string& line)>;

    static constexpr std::chrono::milliseconds PlayInterval {250};
    static constexpr std::uint64_t Slice = 4096; // messages a turn of the run loop

    /// `runLoop`, `observer` and `clock` outlive the model; the clock is set to the moment shown.
    RecordingModel(RunLoop& runLoop, GeneratorFactory makeGenerator, SpectrelModelObserver& observer,
        ViewedClock& clock, RecordingTrack track, Report report, const Context& context);

    bool isConnected() const override
    {
        return _isStarted;
    }
    /// Shows the beginning; once.
    void restartMonitor() override;
    NodeRef topLevelNodes() override;
    NodeRef nodeAtPath(std::string_view path) override;
    ListRef getSaveContents() override
    {
        return nullptr;
    }
    Playback* playback() override
    {
        return this;
    }

    Time duration() const override
    {
        return _track.duration();
    }
    std::uint64_t messageCount() const override
    {
        return _track.messageCount();
    }
    Time time() const override
    {
        return _time;
    }
    std::uint64_t messagesApplied() const override
    {
        return _track.taken();
    }
    bool isPlaying() const override
    {
        return _playTimer != nullptr;
    }
    bool isSeeking() const override
    {
        return _isSeeking;
    }
    int speed() const override
    {
        return _speed;
    }
    const std::string& notice() const override
    {
        return _notice;
    }
    void play() override;
    void pause() override;
    void setSpeed(int speed) override;
    void seek(Time time) override;
    void stepMessage(Direction direction) override;
    void stepTick(Direction direction) override;

private:
    /// Every message up to the time and up to that many is applied, none beyond.
    struct Goal {
        Time time {};
        std::uint64_t messages = 0;
    };

    void seekTo(Time time);
    void moveTo(Goal goal);
    bool rewind();
    void work();
    bool hasArrived() const;
    void applyNext();
    void tellException(const std::string& line);
    void arrive();
    void playOn();

    RunLoop& _runLoop;
    GeneratorFactory _makeGenerator;
    SpectrelModelObserver& _observer;
    ViewedClock& _clock;
    RecordingTrack _track;
    Context _context;
    Report _report;
    Lifetime _lifetime; // of jobs on the queue

    std::optional<OfflineSession> _session;
    NodeRef _nodes;
    PathIndex _nodesByPath;
    bool _isTreeOld = false; // messages were applied or taken back since it was built

    bool _isStarted = false;
    Time _time {};
    Goal _goal;
    bool _isSeeking = false;
    bool _isWorkQueued = false;
    std::unique_ptr<Timer> _playTimer; // while playing
    int _speed = 1;
    std::uint64_t _told = 0; // exceptions of messages up to here were reported
    std::string _notice;
};

} // namespace spectrel
