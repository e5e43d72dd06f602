#include "UI/PlaybackController.h"

#include "Tests/Fakes/FakePlayback.h"
#include "Tests/UI/AppFixture.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class PlaybackControllerTest : public AppFixture {
protected:
    FakePlayback playback;
    PlaybackController controller {playback};
};

TEST_F(PlaybackControllerTest, TimesAreToldFromTheFirstMessageToTheMillisecond)
{
    playback.here = 12'345'678us;
    EXPECT_EQ(controller.timeText(), "00:12.345 / 01:30.000");
    playback.length = 1h;
    EXPECT_EQ(controller.timeText(), "0:00:12.345 / 1:00:00.000");
    playback.length = 1h - 1us;
    EXPECT_EQ(controller.timeText(), "00:12.345 / 59:59.999");
}

TEST_F(PlaybackControllerTest, TheStateIsOneWordAndTheSpeed)
{
    EXPECT_EQ(controller.stateText(), "paused");
    playback.seeks = true;
    EXPECT_EQ(controller.stateText(), "seeking");
    playback.plays = true; // playing on is a row of small seeks
    EXPECT_EQ(controller.stateText(), "playing");
    playback.speedNow = 4;
    EXPECT_EQ(controller.stateText(), "playing 4x");
    playback.plays = playback.seeks = false;
    playback.here = playback.length;
    playback.applied = playback.count;
    EXPECT_EQ(controller.stateText(), "at the end 4x");
}

TEST_F(PlaybackControllerTest, TheLastMomentBeforeItsLastMessageIsNotTheEnd)
{
    playback.here = playback.length;
    EXPECT_FALSE(controller.isAtEnd());
    EXPECT_EQ(controller.messagesText(), "message 1 of 100");
}

TEST_F(PlaybackControllerTest, TheFractionRunsFromNoughtToOne)
{
    EXPECT_EQ(controller.fraction(), 0.0);
    playback.here = 45s;
    EXPECT_EQ(controller.fraction(), 0.5);
    playback.here = playback.length = 0s; // one message
    EXPECT_EQ(controller.fraction(), 1.0);
}

TEST_F(PlaybackControllerTest, OneButtonPlaysAndPauses)
{
    controller.togglePlaying();
    controller.togglePlaying();
    EXPECT_EQ(playback.calls, "play pause ");
}

TEST_F(PlaybackControllerTest, SeekingGoesByTenSecondsAndByFractions)
{
    playback.here = 15s;
    controller.seekStep(Direction::Forward);
    controller.seekStep(Direction::Backward);
    controller.seekToFraction(0.5);
    controller.seekToFraction(-1);
    controller.seekToFraction(7);
    EXPECT_EQ(playback.calls, "seek 25000 seek 5000 seek 45000 seek 0 seek 90000 ");
}

TEST_F(PlaybackControllerTest, TheSpeedDoublesAndHalvesWithinItsBounds)
{
    controller.changeSpeed(Direction::Backward);
    playback.speedNow = 32;
    controller.changeSpeed(Direction::Forward);
    controller.changeSpeed(Direction::Forward);
    controller.changeSpeed(Direction::Backward);
    EXPECT_EQ(playback.calls, "speed 1 speed 64 speed 64 speed 32 ");
}

TEST_F(PlaybackControllerTest, TheApplicationHasOneOnlyWhereSomethingIsPlayed)
{
    launch();
    EXPECT_EQ(app->playback(), nullptr);
    app.reset();
    playing = &playback;
    launch();
    ASSERT_NE(app->playback(), nullptr);
    toolkit.changes.clear();
    observer->playbackDidChange();
    EXPECT_EQ(toolkit.changes.back(), (FakeToolkit::Change {ScreenPart::Playback, Animation::None}));
    app->applicationWillTerminate();
    EXPECT_EQ(app->playback(), nullptr);
}

TEST_F(PlaybackControllerTest, WhatIsAFileAlreadyOffersNoSaving)
{
    offersSaving = false;
    launchAllowingSave();
    EXPECT_FALSE(app->allowSaveButton());
}

} // namespace
} // namespace spectrel
