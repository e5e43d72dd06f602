#include "Monitor/Snapshot.h"

#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/ScratchFolder.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <csignal>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sys/resource.h>

namespace spectrel {
namespace {

constexpr Moment Opened {std::chrono::seconds(1'709'647'651)};

class SnapshotTest : public testing::Test {
protected:
    const ScratchFolder scratch;
    const std::string folder = scratch.path().string();
    std::string reason;
};

TEST_F(SnapshotTest, HoldsTimestampDataAndDescriptionInOrder)
{
    EXPECT_EQ(displayText(makeSnapshot(Opened, List::make({"entry"}), "in the car park")),
        "{\"Timestamp\": \"2024-03-05 14:07:31 +0000\", \"Data\": [\"entry\"], \"Description\": \"in the car park\"}");
}

TEST_F(SnapshotTest, AbsentValueEndsIt)
{
    EXPECT_EQ(displayText(makeSnapshot(Opened, List::make(), std::nullopt)),
        "{\"Timestamp\": \"2024-03-05 14:07:31 +0000\", \"Data\": []}");
    EXPECT_EQ(displayText(makeSnapshot(Opened, nullptr, "x")), "{\"Timestamp\": \"2024-03-05 14:07:31 +0000\"}");
}

TEST_F(SnapshotTest, PathTellsTheSecond)
{
    EXPECT_EQ(
        snapshotPath("/crash", Opened + std::chrono::milliseconds(999)), "/crash/SpectrelSnapshot-1709647651.spectrel");
}

TEST_F(SnapshotTest, FileIsAPropertyListForItsOwnerAlone)
{
    const std::string path = snapshotPath(folder + "/made/at/need", Opened);
    ASSERT_TRUE(writeSnapshot(makeSnapshot(Opened, List::make({"entry"}), ""), path, reason)) << reason;
    EXPECT_EQ(displayText(*readPropertyListFile(path)),
        "{\"Timestamp\": \"2024-03-05 14:07:31 +0000\", \"Data\": [\"entry\"], \"Description\": \"\"}");
    EXPECT_EQ(std::filesystem::status(path).permissions(),
        std::filesystem::perms::owner_read | std::filesystem::perms::owner_write);
}

TEST_F(SnapshotTest, TheSameSecondsFileIsOverwritten)
{
    const std::string path = snapshotPath(folder, Opened);
    ASSERT_TRUE(writeSnapshot(makeSnapshot(Opened, List::make({std::string(5000, 'x')}), "long"), path, reason));
    ASSERT_TRUE(writeSnapshot(makeSnapshot(Opened, List::make(), "short"), path, reason));
    EXPECT_EQ(displayText(*readPropertyListFile(path)),
        "{\"Timestamp\": \"2024-03-05 14:07:31 +0000\", \"Data\": [], \"Description\": \"short\"}");
}

TEST_F(SnapshotTest, AFullDeviceIsTold)
{
    EXPECT_FALSE(writeSnapshot(makeSnapshot(Opened, List::make(), ""), "/dev/full", reason));
    EXPECT_EQ(reason, "No space left on device");
}

TEST_F(SnapshotTest, PlantedLinkIsNotFollowed)
{
    std::ofstream(folder + "/victim") << "untouched";
    const std::string path = snapshotPath(folder, Opened);
    std::filesystem::create_symlink("victim", path);
    EXPECT_FALSE(writeSnapshot(makeSnapshot(Opened, List::make(), ""), path, reason));
    EXPECT_EQ(reason, "it is a link, and links are not followed");
    std::filesystem::remove(path);
    std::filesystem::create_hard_link(folder + "/victim", path);
    EXPECT_FALSE(writeSnapshot(makeSnapshot(Opened, List::make(), ""), path, reason));
    EXPECT_EQ(reason, "it has a further name (a hard link)");
    EXPECT_EQ(std::filesystem::file_size(folder + "/victim"), 9u);
}

TEST_F(SnapshotTest, WithoutRoomTheOlderSnapshotsStayAndNoHalfOneIsLeft)
{
    const std::string older = snapshotPath(folder, Opened);
    ASSERT_TRUE(writeSnapshot(makeSnapshot(Opened, List::make(), "older"), older, reason));
    const auto large = makeSnapshot(Opened, List::make({std::string(100'000, 'x')}), "");
    rlimit before {};
    ASSERT_EQ(::getrlimit(RLIMIT_FSIZE, &before), 0);
    const auto handler = std::signal(SIGXFSZ, SIG_IGN);
    const rlimit little {4096, before.rlim_max};
    ASSERT_EQ(::setrlimit(RLIMIT_FSIZE, &little), 0);
    const bool overOlder = writeSnapshot(large, older, reason);
    const bool besideIt = writeSnapshot(large, folder + "/new.spectrel", reason);
    ::setrlimit(RLIMIT_FSIZE, &before);
    std::signal(SIGXFSZ, handler);
    EXPECT_FALSE(overOlder);
    EXPECT_FALSE(besideIt);
    EXPECT_EQ(reason, "File too large");
    EXPECT_FALSE(std::filesystem::exists(folder + "/new.spectrel"));
    EXPECT_EQ(displayText(*readPropertyListFile(older)),
        "{\"Timestamp\": \"2024-03-05 14:07:31 +0000\", \"Data\": [], \"Description\": \"older\"}");
}

TEST_F(SnapshotTest, DirectoryThatCannotBeMadeIsTold)
{
    std::ofstream(folder + "/file") << "x";
    EXPECT_FALSE(writeSnapshot(makeSnapshot(Opened, List::make(), ""), folder + "/file/below/s.spectrel", reason));
    EXPECT_NE(reason, "");
}

} // namespace
} // namespace spectrel
