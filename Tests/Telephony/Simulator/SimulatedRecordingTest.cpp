#include "Telephony/Simulator/SimulatedRecording.h"

#include "Tests/Fakes/ScratchFolder.h"

#include <algorithm>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <vector>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class SimulatedRecordingTest : public testing::Test {
protected:
    std::string write(Technology technology, Scene scene, std::uint32_t seed, std::chrono::milliseconds duration)
    {
        const auto baseband = makeBaseband(technology, scene, seed);
        EXPECT_TRUE(writeSimulatedRecording(*baseband, path, duration));
        std::ifstream file(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }

    ScratchFolder folder;
    std::string path = folder.path() / "drive.pcap";
};

TEST_F(SimulatedRecordingTest, SameOptionsGiveTheSameBytes)
{
    const std::string first = write(Technology::LTE, Scene::Drive, 7, 30s);
    EXPECT_EQ(first, write(Technology::LTE, Scene::Drive, 7, 30s));
    EXPECT_NE(first, write(Technology::LTE, Scene::Drive, 8, 30s));
    EXPECT_NE(first, write(Technology::LTE, Scene::Walk, 7, 30s));
}

TEST_F(SimulatedRecordingTest, SameOptionsGiveTheSameBytesForUTRANToo)
{
    const std::string first = write(Technology::UTRAN, Scene::Drive, 7, 30s);
    EXPECT_EQ(first, write(Technology::UTRAN, Scene::Drive, 7, 30s));
    EXPECT_NE(first, write(Technology::UTRAN, Scene::Drive, 8, 30s));
    EXPECT_NE(first, write(Technology::UTRAN, Scene::Still, 7, 30s));
    EXPECT_GT(write(Technology::UTRAN, Scene::Stress, 7, 10s).size(), first.size());
}

TEST_F(SimulatedRecordingTest, ItCoversItsDurationFromTheFixedStart)
{
    write(Technology::LTE, Scene::Drive, 1, 60s);
    const auto reader = *openRecording(path);
    EXPECT_EQ(reader->technology(), Technology::LTE);
    RecordedMessage message;
    ASSERT_TRUE(reader->next(message));
    EXPECT_EQ(message.time, SimulatedRecordingStart);
    Moment last;
    while (reader->next(message))
        last = message.time;
    EXPECT_EQ(last, SimulatedRecordingStart + 60s);
}

TEST_F(SimulatedRecordingTest, StressSendsEveryRecordAtEveryStep)
{
    EXPECT_GT(
        write(Technology::LTE, Scene::Stress, 1, 10s).size(), 5 * write(Technology::LTE, Scene::Drive, 1, 10s).size());
}

TEST_F(SimulatedRecordingTest, EachTechnologyOfAJourneyHasAFileOfItsOwn)
{
    const auto baseband = makeBaseband(Technology::LTE, Scene::Journey, 1);
    ASSERT_TRUE(writeSimulatedRecording(*baseband, path, 3min));
    const auto first = *openRecording(path);
    const auto second = *openRecording(folder.path() / "drive-2.pcap");
    const auto third = *openRecording(folder.path() / "drive-3.pcap");
    EXPECT_EQ(first->technology(), Technology::LTE);
    EXPECT_EQ(second->technology(), Technology::UTRAN);
    EXPECT_EQ(third->technology(), Technology::GSM);
    RecordedMessage message;
    Moment end;
    while (first->next(message))
        end = message.time;
    ASSERT_TRUE(second->next(message));
    EXPECT_GE(message.time, end);
    EXPECT_LT(message.time, end + 1s);
}

TEST_F(SimulatedRecordingTest, MovesAreReportedAtTheirTime)
{
    const auto baseband = makeBaseband(Technology::LTE, Scene::Drive, 7);
    std::vector<Moment> times;
    ASSERT_TRUE(
        writeSimulatedRecording(*baseband, path, 5min, [&](Moment time, const Move&) { times.push_back(time); }));
    ASSERT_GT(times.size(), 3U);
    EXPECT_EQ(times.front(), SimulatedRecordingStart);
    EXPECT_LE(times.back(), SimulatedRecordingStart + 5min);
    EXPECT_TRUE(std::ranges::is_sorted(times));
}

TEST_F(SimulatedRecordingTest, FileThatCannotBeMadeIsReported)
{
    const auto baseband = makeBaseband(Technology::LTE, Scene::Drive, 1);
    const auto written = writeSimulatedRecording(*baseband, folder.path() / "no/such/folder", 1s);
    ASSERT_FALSE(written);
    EXPECT_EQ(written.failure().text, (folder.path() / "no/such/folder").string() + ": No such file or directory");
}

} // namespace
} // namespace spectrel
