#include "UI/Quick/PlaybackModel.h"

#include "UI/PlaybackController.h"
#include "UI/Quick/QuickText.h"
#include "UI/SpectrelApp.h"

namespace spectrel {

namespace {

Direction direction(int by)
{
    return by < 0 ? Direction::Backward : Direction::Forward;
}

} // namespace

PlaybackController* PlaybackModel::controller() const
{
    const SpectrelApp* app = _toolkit.application();
    return app ? app->playback() : nullptr;
}

bool PlaybackModel::isThere() const
{
    return controller() != nullptr;
}

bool PlaybackModel::isPlaying() const
{
    return controller() && controller()->isPlaying();
}

double PlaybackModel::fraction() const
{
    return controller() ? controller()->fraction() : 0.0;
}

QString PlaybackModel::stateText() const
{
    return controller() ? shownText(controller()->stateText()) : QString();
}

QString PlaybackModel::timeText() const
{
    return controller() ? shownText(controller()->timeText()) : QString();
}

QString PlaybackModel::messagesText() const
{
    return controller() ? shownText(controller()->messagesText()) : QString();
}

bool PlaybackModel::press(const QString& key)
{
    return controller() && controller()->press(key.toStdString(), KeyTaker::Window);
}

void PlaybackModel::togglePlaying()
{
    if (controller())
        controller()->togglePlaying();
}

void PlaybackModel::stepMessage(int by)
{
    if (controller())
        controller()->stepMessage(direction(by));
}

void PlaybackModel::seekStep(int by)
{
    if (controller())
        controller()->seekStep(direction(by));
}

void PlaybackModel::seekToFraction(double fraction)
{
    if (controller())
        controller()->seekToFraction(fraction);
}

void PlaybackModel::changeSpeed(int by)
{
    if (controller())
        controller()->changeSpeed(direction(by));
}

} // namespace spectrel
