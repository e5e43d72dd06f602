#include "Monitor/Viewing/SnapshotModel.h"

#include "Monitor/Snapshot.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Monitor/Viewing/ViewFixture.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class SnapshotModelTest : public ViewFixture {
protected:
    static DictionaryRef entry(const std::string& date, const std::string& description, const Value& shown)
    {
        return Dictionary::make({{"Display", shown}, {"Date", date}, {"Description", description}});
    }
    static std::string shown(const ListRef& data)
    {
        return displayText(displayOfSnapshot(*Dictionary::make({{"Data", data}})));
    }
};

TEST_F(SnapshotModelTest, EntriesComeNewestFirstUnderDateAndDescription)
{
    EXPECT_EQ(shown(List::make({entry("10:00", "first", Dictionary::make({{"A", "1"}})),
                  entry("10:02", "second", Dictionary::make({{"A", "2"}}))})),
        "{\"10:02  second\": {\"A\": \"2\"}, \"10:00  first\": {\"A\": \"1\"}}");
}

TEST_F(SnapshotModelTest, ADescriptionThatTellsTheDateStandsAlone)
{
    EXPECT_EQ(shown(List::make({entry("10:00", "Snapshot (10:00)", "x")})), "{\"Snapshot (10:00)\": \"x\"}");
}

TEST_F(SnapshotModelTest, EntriesOfOneNameStayApart)
{
    EXPECT_EQ(shown(List::make({entry("10:00", "a", "1"), entry("10:00", "a", "2")})),
        "{\"10:00  a\": \"2\", \"10:00  a (2)\": \"1\"}");
}

TEST_F(SnapshotModelTest, ManyEntriesOfOneNameAreNoObstacle)
{
    constexpr int Count = 20'000;
    auto data = List::make();
    for (int number = 0; number < Count; ++number)
        data->append(Dictionary::make({{"Description", "a"}}));
    const Value display = displayOfSnapshot(*Dictionary::make({{"Data", data}}));
    EXPECT_EQ(display.dictionary()->count(), std::size_t {Count});
    EXPECT_EQ(display.dictionary()->entries().back().key, "a (20000)");
}

TEST_F(SnapshotModelTest, TheBinaryLogIsALeafBehindTheEntries)
{
    const DataRef bytes = std::make_shared<const Bytes>(12);
    EXPECT_EQ(shown(List::make({entry("10:00", "a", "1"),
                  Dictionary::make({{"Description", "DLF binary (12 bytes)"}, {"DLF", bytes}})})),
        "{\"10:00  a\": \"1\", \"DLF binary (12 bytes)\": \"binary log, 12 bytes\"}");
}

TEST_F(SnapshotModelTest, WhatHoldsNoDisplaySaysSo)
{
    EXPECT_EQ(shown(List::make({Dictionary::make(), "text", Dictionary::make({{"Date", "10:00"}})})),
        "{\"10:00\": \"nothing was displayed\", \"Entry 2\": \"(unknown)\", \"Entry 1\": \"nothing was displayed\"}");
}

TEST_F(SnapshotModelTest, NoEntryCanPassForTheMarkerThatSorts)
{
    EXPECT_EQ(
        shown(List::make({entry("", "_sorted", "1"), entry("", "a", "2")})), "{\"a\": \"2\", \"_sorted (2)\": \"1\"}");
}

TEST_F(SnapshotModelTest, ASnapshotFileIsBrowsedWithItsTimeAndDescription)
{
    std::string why;
    const std::string path = scratch.file("a.spectrel");
    const auto data = List::make({entry("10:00", "a", Dictionary::make({{"Cell", Dictionary::make({{"ID", "7"}})}}))});
    ASSERT_TRUE(writeSnapshot(makeSnapshot(Start, data, "in the car park"), path, why)) << why;
    ASSERT_TRUE(view(path)) << reason;
    EXPECT_EQ(screens.reloads, 1);
    EXPECT_TRUE(model->isConnected());
    EXPECT_EQ(model->playback(), nullptr);
    EXPECT_EQ(model->getSaveContents(), nullptr);
    EXPECT_EQ(*model->nodeAtPath("/10:00  a/Cell/ID")->value(), "7");
    EXPECT_EQ(*model->nodeAtPath("/Description")->value(), "in the car park");
    EXPECT_EQ(*model->nodeAtPath("/Timestamp")->value(), "2023-11-14 22:13:20 +0000");
    EXPECT_EQ(file->clock().now(), Start);
}

TEST_F(SnapshotModelTest, AModelThatGoesBeforeItsFirstReloadLeavesNothingBehind)
{
    auto goes = std::make_unique<SnapshotModel>(loop, screens, *Dictionary::make());
    goes->restartMonitor();
    goes.reset();
    loop.runQueued();
    EXPECT_EQ(screens.reloads, 0);
}

} // namespace
} // namespace spectrel
