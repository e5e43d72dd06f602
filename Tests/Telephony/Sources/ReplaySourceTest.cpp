#include "Telephony/Sources/ReplaySource.h"

#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/RecordBuilder.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Tests/Telephony/Collector.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

class ReplaySourceTest : public testing::Test {
protected:
    /// A message a second; byte 12 of each is its number.
    std::string recordingOf(int count, Technology technology = Technology::LTE, int start = 1000)
    {
        std::string path = folder + "/" + std::to_string(++_files) + ".pcap";
        const auto writer = *createRecording(path, technology);
        for (int number = 0; number < count; ++number)
            EXPECT_TRUE(writer->write(Moment(std::chrono::seconds(start + number)),
                RecordBuilder(0xB0C2, 13).u8(12, static_cast<std::uint32_t>(number))));
        EXPECT_TRUE(writer->flush());
        return path;
    }
    std::unique_ptr<LogSource> open(ReplayOptions options)
    {
        auto opened = ReplaySource::open(loop, loop, std::move(options));
        if (opened)
            return *std::move(opened);
        reason = opened.failure().text;
        return nullptr;
    }

    /// The numbers of what was delivered.
    std::vector<int> numbers() const
    {
        std::vector<int> numbers;
        for (const Bytes& message : collector.messages)
            numbers.push_back(message[12]);
        return numbers;
    }
    /// Plays the recording, as fast as it can, between two points.
    std::vector<int> playedBetween(std::optional<ReplayPoint> from, std::optional<ReplayPoint> to)
    {
        const auto source = open({{recordingOf(10)}, 0, false, {}, from, to});
        const auto stream = source->start(collector);
        loop.runQueued();
        return numbers();
    }

    FakeRunLoop loop;
    Collector collector;
    const ScratchFolder scratch;
    const std::string folder = scratch.path().string();
    std::string reason;

private:
    int _files = 0;
};

TEST_F(ReplaySourceTest, ClockThatIsSetNeitherStopsNorHastensTheReplay)
{
    const auto source = open({{recordingOf(9)}, 1, false, {}});
    const auto stream = source->start(collector);
    loop.advance(1s);
    loop.setClock(-1h);
    loop.advance(2s);
    EXPECT_EQ(collector.messages.size(), 4u);
    loop.setClock(3h);
    loop.advance(2s);
    EXPECT_EQ(collector.messages.size(), 6u);
}

TEST_F(ReplaySourceTest, MessagesKeepTheirDistances)
{
    const auto source = open({{recordingOf(5)}, 1, false, {}});
    EXPECT_EQ(source->technology(), Technology::LTE);
    const auto stream = source->start(collector);
    loop.runQueued();
    EXPECT_EQ(collector.messages.size(), 1u);
    loop.advance(2s);
    EXPECT_EQ(collector.messages.size(), 3u);
    loop.advance(60s);
    EXPECT_EQ(collector.messages.size(), 5u);
}

TEST_F(ReplaySourceTest, SpeedShortensThem)
{
    const auto source = open({{recordingOf(5)}, 10, false, {}});
    const auto stream = source->start(collector);
    loop.advance(400ms);
    EXPECT_EQ(collector.messages.size(), 5u);
}

TEST_F(ReplaySourceTest, SpeedZeroIsAsFastAsTheClientTakesThem)
{
    const auto source = open({{recordingOf(500), recordingOf(3)}, 0, false, {}});
    const auto stream = source->start(collector);
    loop.runQueued();
    EXPECT_EQ(collector.messages.size(), 503u);
}

TEST_F(ReplaySourceTest, EachChannelHearsItFromTheStart)
{
    const auto source = open({{recordingOf(3)}, 0, false, {}});
    const auto first = source->start(collector);
    loop.runQueued();
    Collector late;
    const auto second = source->start(late);
    loop.runQueued();
    EXPECT_EQ(collector.messages, late.messages);
}

TEST_F(ReplaySourceTest, LoopBeginsAnew)
{
    const auto source = open({{recordingOf(2)}, 1, true, {}});
    const auto stream = source->start(collector);
    loop.advance(10s);
    EXPECT_GT(collector.messages.size(), 10u);
}

TEST_F(ReplaySourceTest, LoopOverNothingEnds)
{
    const auto source = open({{recordingOf(0)}, 0, true, {}});
    const auto stream = source->start(collector);
    loop.advance(10s);
    EXPECT_TRUE(collector.messages.empty());
}

TEST_F(ReplaySourceTest, SlowClientLosesNothing)
{
    const auto source = open({{recordingOf(5)}, 0, false, {}});
    collector.isFull = true;
    const auto stream = source->start(collector);
    loop.advance(10s);
    collector.isFull = false;
    stream->resume();
    loop.runQueued();
    ASSERT_EQ(collector.messages.size(), 5u);
    for (std::size_t number = 0; number < 5; ++number)
        EXPECT_EQ(collector.messages[number][12], number);
}

TEST_F(ReplaySourceTest, PartOfTheRecordingIsPlayedFromAndToItsTimes)
{
    EXPECT_THAT(playedBetween(ReplayPoint::after(3s), ReplayPoint::after(5s)), ElementsAre(3, 4, 5));
}

TEST_F(ReplaySourceTest, FromGoesToTheEndAndToComesFromTheStart)
{
    EXPECT_THAT(playedBetween(ReplayPoint::after(8s), {}), ElementsAre(8, 9));
    collector.messages.clear();
    EXPECT_THAT(playedBetween({}, ReplayPoint::after(1500ms)), ElementsAre(0, 1));
}

TEST_F(ReplaySourceTest, WallClockTimesChooseThePart)
{
    // The recording starts at 1970-01-01 00:16:40 UTC.
    EXPECT_THAT(playedBetween(ReplayPoint::wallClock("1970-01-01 00:16:42Z"), ReplayPoint::wallClock("00:16:44Z")),
        ElementsAre(2, 3, 4));
}

TEST_F(ReplaySourceTest, NothingBetweenTheTimesEndsAtOnceEvenInALoop)
{
    const auto source = open({{recordingOf(5)}, 1, true, {}, ReplayPoint::after(1h), {}});
    const auto stream = source->start(collector);
    loop.advance(10s);
    EXPECT_THAT(numbers(), IsEmpty());
    EXPECT_EQ(loop.waitingJobs(), 0u);
}

TEST_F(ReplaySourceTest, PassingOverALongStartLetsOthersHaveTheirTurn)
{
    const auto source = open({{recordingOf(50'000)}, 0, false, {}, ReplayPoint::after(49'999s), {}});
    const auto stream = source->start(collector);
    int turns = 0;
    loop.async([&] { turns += static_cast<int>(collector.messages.size()); });
    loop.runQueued();
    EXPECT_EQ(turns, 0) << "the other job had to wait for the whole recording";
    EXPECT_EQ(collector.messages.size(), 1u);
}

TEST_F(ReplaySourceTest, PartOfTheRecordingLoops)
{
    const auto source = open({{recordingOf(10)}, 1, true, {}, ReplayPoint::after(4s), ReplayPoint::after(5s)});
    const auto stream = source->start(collector);
    loop.advance(2500ms);
    EXPECT_THAT(numbers(), ElementsAre(4, 5, 4, 5, 4));
}

TEST_F(ReplaySourceTest, FileRecordedEarlierKeepsItsOwnPace)
{
    const auto source =
        open({{recordingOf(2, Technology::LTE, 5000), recordingOf(3, Technology::LTE, 1000)}, 1, false, {}});
    const auto stream = source->start(collector);
    loop.advance(1s);
    EXPECT_THAT(numbers(), ElementsAre(0, 1, 0));
    loop.advance(1s);
    EXPECT_THAT(numbers(), ElementsAre(0, 1, 0, 1));
}

TEST_F(ReplaySourceTest, LongTimeBetweenTwoFilesIsNotWaitedForAShortOneIs)
{
    const auto source = open({{recordingOf(1, Technology::LTE, 1000), recordingOf(1, Technology::LTE, 1005),
                                  recordingOf(1, Technology::LTE, 9000)},
        1, false, {}});
    const auto stream = source->start(collector);
    loop.advance(4s);
    EXPECT_EQ(collector.messages.size(), 1u);
    loop.advance(1s);
    EXPECT_EQ(collector.messages.size(), 3u);
}

TEST_F(ReplaySourceTest, FilesOfTwoTechnologiesAreRefused)
{
    EXPECT_EQ(open({{recordingOf(1), recordingOf(1, Technology::GSM)}, 1, false, {}}), nullptr);
    EXPECT_NE(reason.find("2.pcap: is of technology gsm"), std::string::npos) << reason;
}

TEST_F(ReplaySourceTest, MissingFileIsNamed)
{
    EXPECT_EQ(open({{folder + "/nowhere.pcap"}, 1, false, {}}), nullptr);
    EXPECT_NE(reason.find("nowhere.pcap: "), std::string::npos) << reason;
}

} // namespace
} // namespace spectrel
