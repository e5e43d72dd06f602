#include "Monitor/Viewing/RecordingModel.h"

#include "Tests/Monitor/Viewing/ViewFixture.h"

#include <algorithm>
#include <filesystem>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class RecordingModelTest : public ViewFixture {
protected:
    /// Identities 1, 2, ... at 0 s, 1 s, 2.5 s, 10 s.
    void viewDrive()
    {
        ASSERT_TRUE(view(writeRecording({{0s, cell(1)}, {1s, cell(2)}, {2500ms, cell(3)}, {10s, cell(4)}}))) << reason;
    }
    /// So many messages, a millisecond apart, the identity being the number counted from 0.
    std::string longDrive(std::uint32_t count) const
    {
        std::vector<Timed> messages;
        for (std::uint32_t number = 0; number < count; ++number)
            messages.push_back({std::chrono::milliseconds(number), cell(number)});
        return writeRecording(messages);
    }
};

TEST_F(RecordingModelTest, ItStandsPausedAtItsFirstMoment)
{
    viewDrive();
    EXPECT_EQ(place(), "0 ms, 1: 1");
    EXPECT_FALSE(playback().isPlaying());
    EXPECT_EQ(playback().duration(), 10s);
    EXPECT_EQ(playback().messageCount(), 4U);
    EXPECT_EQ(screens.reloads, 1);
    EXPECT_TRUE(model->isConnected());
    EXPECT_EQ(model->getSaveContents(), nullptr);
    EXPECT_EQ(model->topLevelNodes()->childNodes()->size(), 2U);
}

TEST_F(RecordingModelTest, StartingAgainChangesNothing)
{
    viewDrive();
    playback().seek(3s);
    model->restartMonitor();
    EXPECT_EQ(place(), "3000 ms, 3: 3");
}

TEST_F(RecordingModelTest, PlayingAppliesEachMessageAtItsTime)
{
    viewDrive();
    playback().play();
    loop.advance(900ms);
    EXPECT_EQ(place(), "750 ms, 1: 1");
    loop.advance(100ms);
    EXPECT_EQ(place(), "1000 ms, 2: 2");
    loop.advance(1500ms);
    EXPECT_EQ(place(), "2500 ms, 3: 3");
    EXPECT_EQ(screens.reloads, 3) << "the tree is read anew only when messages came";
}

TEST_F(RecordingModelTest, PlayingEndsAtTheEndAndThenStartsOver)
{
    viewDrive();
    playback().play();
    loop.advance(11s);
    EXPECT_EQ(place(), "10000 ms, 4: 4");
    EXPECT_FALSE(playback().isPlaying());
    EXPECT_EQ(loop.timers(), 0U) << "at rest nothing runs";
    playback().play();
    EXPECT_EQ(place(), "0 ms, 1: 1");
    EXPECT_TRUE(playback().isPlaying());
}

TEST_F(RecordingModelTest, PausingStopsTheClock)
{
    viewDrive();
    playback().play();
    loop.advance(1s);
    playback().pause();
    loop.advance(60s);
    EXPECT_EQ(place(), "1000 ms, 2: 2");
    EXPECT_EQ(loop.timers(), 0U);
}

TEST_F(RecordingModelTest, ATwofoldSpeedTakesHalfTheTime)
{
    viewDrive();
    playback().setSpeed(2);
    playback().play();
    loop.advance(500ms);
    EXPECT_EQ(place(), "1000 ms, 2: 2");
    playback().setSpeed(0);
    EXPECT_EQ(playback().speed(), 1);
    playback().setSpeed(1000);
    EXPECT_EQ(playback().speed(), Playback::FastestSpeed);
}

TEST_F(RecordingModelTest, SteppingGoesMessageByMessageBothWays)
{
    viewDrive();
    playback().stepMessage(Direction::Forward);
    EXPECT_EQ(place(), "1000 ms, 2: 2");
    playback().stepMessage(Direction::Forward);
    EXPECT_EQ(place(), "2500 ms, 3: 3");
    playback().stepMessage(Direction::Backward);
    EXPECT_EQ(place(), "1000 ms, 2: 2");
    playback().stepMessage(Direction::Backward);
    playback().stepMessage(Direction::Backward);
    EXPECT_EQ(place(), "0 ms, 1: 1") << "one message stays, so that there is something to see";
}

TEST_F(RecordingModelTest, MessagesOfOneMomentAreSteppedOneByOneAndSoughtTogether)
{
    ASSERT_TRUE(view(writeRecording({{0s, cell(1)}, {1s, cell(2)}, {1s, cell(3)}, {2s, cell(4)}})));
    playback().stepMessage(Direction::Forward);
    EXPECT_EQ(place(), "1000 ms, 2: 2");
    playback().stepMessage(Direction::Forward);
    EXPECT_EQ(place(), "1000 ms, 3: 3");
    playback().seek(0s);
    playback().seek(1s);
    EXPECT_EQ(place(), "1000 ms, 3: 3");
}

TEST_F(RecordingModelTest, SteppingPastTheEndsDoesNothing)
{
    viewDrive();
    playback().seek(10s);
    playback().stepMessage(Direction::Forward);
    EXPECT_EQ(place(), "10000 ms, 4: 4");
}

TEST_F(RecordingModelTest, TicksAreThoseOfTheLiveSession)
{
    viewDrive();
    playback().stepTick(Direction::Forward);
    EXPECT_EQ(place(), "2000 ms, 2: 2");
    playback().stepTick(Direction::Forward);
    EXPECT_EQ(place(), "4000 ms, 3: 3");
    playback().seek(3s);
    playback().stepTick(Direction::Backward);
    EXPECT_EQ(place(), "2000 ms, 2: 2");
    playback().stepTick(Direction::Backward);
    playback().stepTick(Direction::Backward);
    EXPECT_EQ(place(), "0 ms, 1: 1");
    playback().seek(9s);
    playback().stepTick(Direction::Forward);
    playback().stepTick(Direction::Forward);
    EXPECT_EQ(place(), "10000 ms, 4: 4");
}

TEST_F(RecordingModelTest, SteppingPauses)
{
    viewDrive();
    playback().play();
    playback().stepTick(Direction::Forward);
    EXPECT_FALSE(playback().isPlaying());
    playback().play();
    playback().stepMessage(Direction::Forward);
    EXPECT_FALSE(playback().isPlaying());
}

TEST_F(RecordingModelTest, SeekingGoesToAnyMomentBothWaysAndKeepsPlaying)
{
    viewDrive();
    playback().play();
    playback().seek(9999ms);
    EXPECT_EQ(place(), "9999 ms, 3: 3");
    playback().seek(999ms);
    EXPECT_EQ(place(), "999 ms, 1: 1");
    EXPECT_TRUE(playback().isPlaying());
    playback().seek(-5s);
    EXPECT_EQ(place(), "0 ms, 1: 1");
    playback().seek(1h);
    EXPECT_EQ(place(), "10000 ms, 4: 4");
}

TEST_F(RecordingModelTest, GoingBackShowsWhatDecodingUpToThereShows)
{
    ASSERT_TRUE(view(writeRecording({{0s, RecordBuilder(0xB0C2, 38).bytes()}, {1s, cell(2)}, {2s, cell(3)}})));
    playback().seek(2s);
    playback().seek(0s);
    EXPECT_EQ(place(), "0 ms, 1: 0");
}

TEST_F(RecordingModelTest, TheClockOfTheScreensStandsAtTheMomentShown)
{
    viewDrive();
    EXPECT_EQ(file->clock().now(), Start);
    playback().seek(2s);
    EXPECT_EQ(file->clock().now(), Start + 2s);
}

TEST_F(RecordingModelTest, ALongWayIsGoneInTurnsOfTheRunLoopAndShownOnArrival)
{
    constexpr std::uint32_t Count = 3 * RecordingModel::Slice;
    ASSERT_TRUE(view(longDrive(Count)));
    const int reloads = screens.reloads;
    playback().seek(1h);
    EXPECT_TRUE(playback().isSeeking());
    EXPECT_EQ(identity(), "0") << "the tree stays until the place is reached";
    EXPECT_EQ(playback().time(), playback().duration());
    loop.runQueued();
    EXPECT_FALSE(playback().isSeeking());
    EXPECT_EQ(identity(), std::to_string(Count - 1));
    EXPECT_EQ(screens.reloads, reloads + 1);
}

TEST_F(RecordingModelTest, APlaceIsNeverShownWithTheTreeOfAnother)
{
    viewDrive();
    std::string shown = identity();
    screens.atReload = [&] { shown = identity(); };
    screens.atPlaybackChange = [&] { EXPECT_EQ(shown, std::to_string(playback().messagesApplied())); };
    playback().stepMessage(Direction::Forward);
    playback().stepMessage(Direction::Backward);
    playback().seek(3s);
    playback().play();
    loop.advance(10s);
    EXPECT_EQ(place(), "10000 ms, 4: 4");
}

TEST_F(RecordingModelTest, ANewWishTakesThePlaceOfTheOneUnderWay)
{
    ASSERT_TRUE(view(longDrive(3 * RecordingModel::Slice)));
    playback().seek(1h);
    playback().seek(5ms);
    EXPECT_EQ(place(), "5 ms, 6: 5");
    loop.runQueued();
    EXPECT_EQ(place(), "5 ms, 6: 5");
}

TEST_F(RecordingModelTest, StepsBackAddUpWhileTheFirstIsUnderWay)
{
    constexpr std::uint32_t Count = 5 * RecordingModel::Slice;
    ASSERT_TRUE(view(longDrive(Count)));
    playback().seek(1h);
    loop.runQueued();
    for (int step = 0; step < 3; ++step)
        playback().stepMessage(Direction::Backward);
    EXPECT_TRUE(playback().isSeeking());
    loop.runQueued();
    EXPECT_EQ(playback().messagesApplied(), Count - 3);
    EXPECT_EQ(identity(), std::to_string(Count - 4));
}

TEST_F(RecordingModelTest, AModelThatGoesWhileSeekingLeavesNothingBehind)
{
    ASSERT_TRUE(view(longDrive(3 * RecordingModel::Slice)));
    const int reloads = screens.reloads;
    playback().play();
    playback().seek(1h);
    model.reset();
    loop.runQueued();
    loop.advance(1s);
    EXPECT_EQ(screens.reloads, reloads);
}

TEST_F(RecordingModelTest, AMessageThatWouldEndTheProgramIsToldAndPausesThePlaying)
{
    ASSERT_TRUE(view(writeRecording({{0s, cell(1)}, {1s, garbage()}, {2s, cell(3)}})));
    playback().play();
    loop.advance(3s);
    EXPECT_FALSE(playback().isPlaying());
    EXPECT_EQ(place(), "1000 ms, 2: 1");
    EXPECT_EQ(playback().notice(),
        "message 1 (code 0xFF0000) would have ended the program: spectrel::LogCode_0xFF0000::UnknownDataException");
    EXPECT_EQ(reported, playback().notice() + "\n");
    playback().play();
    EXPECT_EQ(playback().notice(), "");
    loop.advance(3s);
    EXPECT_EQ(place(), "2000 ms, 3: 3") << "it goes on behind it";
}

TEST_F(RecordingModelTest, SeekingPastSuchAMessageArrivesAndReportsItOnlyOnce)
{
    ASSERT_TRUE(view(writeRecording({{0s, cell(1)}, {1s, garbage()}, {2s, cell(3)}})));
    for (int times = 0; times < 2; ++times) {
        playback().seek(2s);
        EXPECT_EQ(place(), "2000 ms, 3: 3");
        EXPECT_NE(playback().notice(), "");
        playback().seek(0s);
    }
    EXPECT_EQ(std::ranges::count(reported, '\n'), 1);
}

TEST_F(RecordingModelTest, ADamagedEndIsToldWhereItIsReached)
{
    const std::string path = writeRecording({{0s, cell(1)}, {1s, cell(2)}, {2s, cell(3)}});
    std::filesystem::resize_file(path, std::filesystem::file_size(path) - 5);
    ASSERT_TRUE(view(path));
    EXPECT_NE(file->damage(), "");
    EXPECT_EQ(playback().messageCount(), 2U);
    EXPECT_EQ(playback().notice(), "");
    playback().seek(1s);
    EXPECT_EQ(playback().notice(), file->damage());
}

TEST_F(RecordingModelTest, AFileThatHasGoneLetsNobodyBackAndLosesNothing)
{
    viewDrive();
    playback().seek(3s);
    std::filesystem::remove(scratch.file("a.pcap"));
    playback().seek(0s);
    EXPECT_EQ(playback().notice(), "cannot go back: No such file or directory");
    EXPECT_EQ(place(), "2500 ms, 3: 3");
    EXPECT_FALSE(playback().isSeeking());
    playback().seek(10s);
    EXPECT_EQ(place(), "10000 ms, 4: 4");
}

TEST_F(RecordingModelTest, TimesThatRunBackwardsStandStill)
{
    ASSERT_TRUE(view(writeRecording({{5s, cell(1)}, {1s, cell(2)}, {6s, cell(3)}})));
    EXPECT_EQ(place(), "0 ms, 2: 2");
    EXPECT_EQ(playback().duration(), 1s);
}

TEST_F(RecordingModelTest, WithoutTimesTenMessagesMakeASecond)
{
    ASSERT_TRUE(view(writeRecording({{0s, cell(1)}, {0s, cell(2)}, {0s, cell(3)}})));
    EXPECT_EQ(place(), "0 ms, 1: 1");
    EXPECT_EQ(playback().duration(), 200ms);
    playback().seek(100ms);
    EXPECT_EQ(place(), "100 ms, 2: 2");
    EXPECT_EQ(file->clock().now(), Start) << "the recording tells no other moment";
}

TEST_F(RecordingModelTest, OneMessageIsAWholeRecording)
{
    ASSERT_TRUE(view(writeRecording({{0s, cell(1)}})));
    EXPECT_EQ(place(), "0 ms, 1: 1");
    playback().play();
    loop.advance(1s);
    EXPECT_EQ(place(), "0 ms, 1: 1");
    EXPECT_FALSE(playback().isPlaying());
}

} // namespace
} // namespace spectrel
