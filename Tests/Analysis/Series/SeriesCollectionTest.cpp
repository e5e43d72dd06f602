#include "Analysis/Series/SeriesCollection.h"

#include "LogGenerator/LogGenerator.h"
#include "Monitor/Viewing/OfflineSession.h"
#include "Records/Recording.h"
#include "Tests/Fakes/SourceFolder.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

/// A display without a technology, which has leaves but no cells.
class SeriesCollectionTest : public testing::Test {
protected:
    SeriesCollectionTest()
        : display(&LogGenerator::generatorFromTechnology, Context())
        , analysis(display)
        , collection(display, analysis)
    {
        const_cast<Dictionary&>(display.state()).set(StateKey::Display, shown);
        refresh();
    }
    /// A message comes, after which the display is refreshed.
    void refresh()
    {
        display.apply({}, time);
        analysis.refresh(time);
        time += 2s;
    }
    std::string recent(std::string_view name) const
    {
        const Series* const series = collection.find(name);
        if (!series)
            return "none";
        std::string text;
        for (std::size_t index = 0; index < collection.axis().recentCount(); ++index) {
            const auto value = series->recent(collection.axis(), index);
            text += value ? std::to_string(static_cast<int>(*value)) + " " : "- ";
        }
        return text;
    }

    const DictionaryRef shown = Dictionary::make();
    DisplayState display;
    Analysis analysis;
    SeriesCollection collection;
    Moment time {std::chrono::seconds(1'700'000'000)};
};

TEST_F(SeriesCollectionTest, LeafThatShowsANumberIsASeries)
{
    shown->setText("RSRP", "-100 dBm");
    refresh();
    refresh();
    shown->setText("RSRP", "-");
    refresh();
    shown->setText("RSRP", "-90 dBm");
    refresh();
    shown->remove("RSRP");
    refresh();
    EXPECT_EQ(recent("/RSRP"), "- -100 -100 - -90 - ");
    EXPECT_EQ(collection.names(), std::vector<std::string_view> {"/RSRP"});
}

TEST_F(SeriesCollectionTest, ListsThatAreFilledAnewGoOn)
{
    const auto list = List::make({});
    shown->set("Cells", list);
    for (int round = 1; round <= 3; ++round) {
        list->removeAll();
        list->append(Dictionary::make({{"Level", std::to_string(round)}, {"Name", "x"}}));
        refresh();
    }
    EXPECT_EQ(recent("/Cells/0/Level"), "- 1 2 3 ");
    EXPECT_EQ(recent("/Cells/0/Name"), "none");
}

TEST_F(SeriesCollectionTest, NoMoreSeriesThanThereIsRoomFor)
{
    for (int leaf = 0; leaf < 1000; ++leaf)
        shown->setText("leaf " + std::to_string(leaf), "1");
    shown->setText(std::string(500, 'x'), "1");
    refresh();
    EXPECT_EQ(collection.names().size(), SeriesCollection::MostSeries);
    EXPECT_EQ(collection.dropped(), 1001 - SeriesCollection::MostSeries);
    EXPECT_EQ(recent("/leaf 7"), "- 1 ");
}

TEST_F(SeriesCollectionTest, NothingIsKeptOfNoDisplay)
{
    const_cast<Dictionary&>(display.state()).remove(StateKey::Display);
    refresh();
    EXPECT_TRUE(collection.names().empty());
    EXPECT_TRUE(collection.cells().empty());
    EXPECT_TRUE(collection.moves().empty());
}

/// The collection of a golden recording, refreshed by its clock.
class RecordedSeriesTest : public testing::Test {
protected:
    RecordedSeriesTest()
        : resources(sourcePath("Resources"))
        , session(&LogGenerator::generatorFromTechnology, false, Context {.resources = resources})
        , analysis(session.displayState())
        , collection(session.displayState(), analysis)
    {
        session.setTickHandler([this](Moment tick) { analysis.refresh(tick); });
    }
    void play(const char* name)
    {
        const auto reader = openRecording(sourcePath(std::string("Tests/Golden/") + name));
        ASSERT_TRUE(reader);
        session.useTechnology(*(*reader)->technology());
        RecordedMessage message;
        while ((*reader)->next(message))
            session.apply(message);
        analysis.refresh(session.lastTime());
    }

    DirectoryResources resources;
    OfflineSession session;
    Analysis analysis;
    SeriesCollection collection;
};

TEST_F(RecordedSeriesTest, LevelsAreKeptOverallAndForEachServingCell)
{
    play("lte-five-minutes.pcap");
    const Series* const rsrp = collection.level(Level::RSRP);
    ASSERT_TRUE(rsrp);
    const Statistics& all = rsrp->statistics();
    ASSERT_GT(all.count(), 100u);
    EXPECT_LT(all.min(), all.mean());
    EXPECT_LT(all.mean(), all.max());
    EXPECT_LE(all.percentile(0.05), all.percentile(0.95));
    ASSERT_FALSE(collection.cells().empty());
    std::uint64_t counted = 0;
    std::chrono::microseconds served {0};
    for (const ServedCell& cell : collection.cells()) {
        counted += cell.level(Level::RSRP) ? cell.level(Level::RSRP)->count() : 0;
        served += cell.served;
        EXPECT_EQ(cell.cell.technology, RadioTechnology::LTE);
        EXPECT_LE(cell.first, cell.last);
    }
    EXPECT_EQ(counted, all.count());
    EXPECT_GT(served, 4min);
    EXPECT_LE(served, 5min);
    ASSERT_GE(collection.moves().size(), collection.cells().size());
    EXPECT_EQ(collection.moves().front().cell, 0u);
    EXPECT_TRUE(collection.find("/Serving Cell Measurements/Measured RSRP"));
    EXPECT_EQ(collection.dropped(), 0u);
}

TEST_F(RecordedSeriesTest, EachTechnologyHasItsLevels)
{
    for (const auto& [name, level] : std::vector<std::pair<const char*, Level>> {{"gsm-drive.pcap", Level::RSSI},
             {"cdma-drive.pcap", Level::EcIo}, {"utran-five-minutes.pcap", Level::RSCP}}) {
        play(name);
        ASSERT_TRUE(collection.level(level)) << name;
        EXPECT_GT(collection.level(level)->statistics().count(), 0u) << name;
    }
}

} // namespace
} // namespace spectrel
