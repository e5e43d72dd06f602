#include "Monitor/Snapshot.h"

#include "Platform/Dictionary.h"
#include "Platform/PropertyList.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <unistd.h>

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

TEST_F(SnapshotTest, DirectoryThatCannotBeMadeIsTold)
{
    std::ofstream(folder + "/file") << "x";
    EXPECT_FALSE(writeSnapshot(makeSnapshot(Opened, List::make(), ""), folder + "/file/below/s.spectrel", reason));
    EXPECT_NE(reason, "");
}

} // namespace
} // namespace spectrel
