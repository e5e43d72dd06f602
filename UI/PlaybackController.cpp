#include "UI/PlaybackController.h"

#include <algorithm>
#include <cstdio>

namespace spectrel {

namespace {

/// Hours only where the whole length has some.
std::string clockText(Playback::Time time, bool hasHours)
{
    const auto milliseconds = std::chrono::duration_cast<std::chrono::milliseconds>(time).count();
    const auto minutes = static_cast<long long>(milliseconds / 60'000);
    char text[48];
    if (hasHours)
        std::snprintf(text, sizeof text, "%lld:%02lld", minutes / 60, minutes % 60);
    else
        std::snprintf(text, sizeof text, "%02lld", minutes);
    char seconds[16];
    std::snprintf(seconds, sizeof seconds, ":%02d.%03d", static_cast<int>(milliseconds / 1000 % 60),
        static_cast<int>(milliseconds % 1000));
    return std::string(text) + seconds;
}

} // namespace

bool PlaybackController::isAtEnd() const
{
    return _playback.time() >= _playback.duration() && _playback.messagesApplied() >= _playback.messageCount();
}

double PlaybackController::fraction() const
{
    const auto duration = static_cast<double>(_playback.duration().count());
    return duration > 0 ? static_cast<double>(_playback.time().count()) / duration : 1.0;
}

std::string PlaybackController::stateText() const
{
    const std::string speed = _playback.speed() > 1 ? " " + std::to_string(_playback.speed()) + "x" : std::string();
    if (_playback.isPlaying())
        return "playing" + speed;
    if (_playback.isSeeking())
        return "seeking";
    return (isAtEnd() ? "at the end" : "paused") + speed;
}

std::string PlaybackController::timeText() const
{
    const bool hasHours = _playback.duration() >= std::chrono::hours(1);
    return clockText(_playback.time(), hasHours) + " / " + clockText(_playback.duration(), hasHours);
}

std::string PlaybackController::messagesText() const
{
    return "message " + std::to_string(_playback.messagesApplied()) + " of " + std::to_string(_playback.messageCount());
}

bool PlaybackController::press(std::string_view key, KeyTaker taker)
{
    const auto action = actionOf(key, taker, KeyScope::Playing);
    if (action)
        perform(*action, key);
    return action.has_value();
}

void PlaybackController::perform(KeyAction action, std::string_view key)
{
    switch (action) {
    case KeyAction::PlayOrPause:
        return togglePlaying();
    case KeyAction::NextMessage:
        return stepMessage(Direction::Forward);
    case KeyAction::PreviousMessage:
        return stepMessage(Direction::Backward);
    case KeyAction::NextTick:
        return stepTick(Direction::Forward);
    case KeyAction::PreviousTick:
        return stepTick(Direction::Backward);
    case KeyAction::SeekForward:
        return seekStep(Direction::Forward);
    case KeyAction::SeekBackward:
        return seekStep(Direction::Backward);
    case KeyAction::SeekToTenth:
        return seekToFraction((key.front() - '0') / 10.0);
    case KeyAction::SeekToEnd:
        return seekToFraction(1);
    case KeyAction::Faster:
        return changeSpeed(Direction::Forward);
    case KeyAction::Slower:
        return changeSpeed(Direction::Backward);
    default:
        return;
    }
}

void PlaybackController::togglePlaying()
{
    if (_playback.isPlaying())
        _playback.pause();
    else
        _playback.play();
}

void PlaybackController::seekStep(Direction direction)
{
    _playback.seek(_playback.time() + static_cast<int>(direction) * Playback::Time(SeekStep));
}

void PlaybackController::seekToFraction(double fraction)
{
    const double kept = std::clamp(fraction, 0.0, 1.0);
    if (kept >= 1.0) // the very end, whatever rounding does
        return _playback.seek(_playback.duration());
    _playback.seek(Playback::Time(static_cast<std::int64_t>(static_cast<double>(_playback.duration().count()) * kept)));
}

void PlaybackController::changeSpeed(Direction direction)
{
    const int speed = _playback.speed();
    _playback.setSpeed(std::clamp(direction == Direction::Forward ? speed * 2 : speed / 2, 1, Playback::FastestSpeed));
}

} // namespace spectrel
