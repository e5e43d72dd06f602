#include "Sections/GSMUMTS/GSM/NeighboringCells.h"

#include "Tests/Sections/CellInformation.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

struct Neighbour {
    std::uint32_t arfcn;
    std::uint32_t level;
    std::uint32_t c1;
};

class NeighboringCellsTest : public SectionFixture<NeighboringCells> {
protected:
    NeighboringCellsTest()
        : SectionFixture(List::make({"old"}))
    {
    }

    static RecordBuilder measured(const std::vector<Neighbour>& neighbours)
    {
        RecordBuilder record(0x5137, 29 + 14 * neighbours.size());
        record.u8(28, static_cast<std::uint32_t>(neighbours.size()));
        for (std::size_t i = 0; i < neighbours.size(); ++i) {
            const std::size_t entry = 29 + 14 * i;
            record.u16(entry, neighbours[i].arfcn).u8(entry + 2, neighbours[i].level).u32(entry + 3, neighbours[i].c1);
        }
        return record;
    }
    static RecordBuilder bsics(const std::vector<std::pair<std::uint32_t, std::uint32_t>>& entries)
    {
        RecordBuilder record(0x51FF, 15 + 4 * entries.size());
        record.u8(14, static_cast<std::uint32_t>(entries.size()));
        for (std::size_t i = 0; i < entries.size(); ++i)
            record.u16(15 + 4 * i, entries[i].first).u8(17 + 4 * i, entries[i].second).u8(18 + 4 * i, 0xEE);
        return record;
    }
    static DictionaryRef neighbour(std::int64_t arfcn, std::int64_t level)
    {
        return informationOfCell(kRKCellMonitorRadioAccessTechnologyGSM, kRKCellMonitorCellTypeNeighbor,
            {{kRKCellMonitorARFCN, arfcn}, {kRKCellMonitorRSSI, level}});
    }
};

constexpr const char* Trace = "<4>NeighboringCells\n";

TEST_F(NeighboringCellsTest, SubscribesToItsThreeCodes)
{
    EXPECT_EQ(section.getSectionName(), "Neighboring Cells");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x5137, 0x51FF, 0xFF0001}));
}

TEST_F(NeighboringCellsTest, MeasuredNeighboursAreListedWithTheirKeysInOrder)
{
    deliver(0x5137, measured({{50, 31, 12}, {65535, 255, 0xFFFFFFFE}}));
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"50\", \"RSSI\": \"31\", \"C1 Value\": \"12\"}, "
        "{\"ARFCN\": \"65535\", \"RSSI\": \"255\", \"C1 Value\": \"-2\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(NeighboringCellsTest, BSICIsShownForTheChannelsThatWereListed)
{
    deliver(0x51FF, bsics({{50, 7}}));
    EXPECT_EQ(display(), "[\"old\"]");
    deliver(0x5137, measured({{50, 31, 12}, {51, 30, 11}}));
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"50\", \"RSSI\": \"31\", \"C1 Value\": \"12\", \"BSIC\": \"7\"}, "
        "{\"ARFCN\": \"51\", \"RSSI\": \"30\", \"C1 Value\": \"11\"}]");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(NeighboringCellsTest, LaterEntryOfAChannelWinsAndEachListReplacesTheLast)
{
    deliver(0x51FF, bsics({{50, 7}, {51, 8}, {50, 9}}));
    deliver(0x5137, measured({{50, 1, 1}, {51, 1, 1}}));
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"50\", \"RSSI\": \"1\", \"C1 Value\": \"1\", \"BSIC\": \"9\"}, "
        "{\"ARFCN\": \"51\", \"RSSI\": \"1\", \"C1 Value\": \"1\", \"BSIC\": \"8\"}]");
    deliver(0x51FF, bsics({{51, 10}}));
    deliver(0x5137, measured({{50, 1, 1}, {51, 1, 1}}));
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"50\", \"RSSI\": \"1\", \"C1 Value\": \"1\"}, "
        "{\"ARFCN\": \"51\", \"RSSI\": \"1\", \"C1 Value\": \"1\", \"BSIC\": \"10\"}]");
}

TEST_F(NeighboringCellsTest, BSICListOneByteTooShortKeepsWhatIsKnownAndAnEmptyOneForgetsIt)
{
    deliver(0x51FF, bsics({{50, 7}}));
    deliver(0x51FF, RecordBuilder(0x51FF, 14));
    deliver(0x5137, measured({{50, 1, 1}}));
    EXPECT_EQ(display(), "[{\"ARFCN\": \"50\", \"RSSI\": \"1\", \"C1 Value\": \"1\", \"BSIC\": \"7\"}]");
    deliver(0x51FF, RecordBuilder(0x51FF, 15));
    deliver(0x5137, measured({{50, 1, 1}}));
    EXPECT_EQ(display(), "[{\"ARFCN\": \"50\", \"RSSI\": \"1\", \"C1 Value\": \"1\"}]");
}

TEST_F(NeighboringCellsTest, BSICEntriesPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x51FF, RecordBuilder(0x51FF, 15).u8(14, 255));
    deliver(0x5137, measured({{0, 1, 1}, {1, 1, 1}}));
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"0\", \"RSSI\": \"1\", \"C1 Value\": \"1\", \"BSIC\": \"0\"}, "
        "{\"ARFCN\": \"1\", \"RSSI\": \"1\", \"C1 Value\": \"1\"}]");
}

TEST_F(NeighboringCellsTest, MeasurementWithoutNeighboursEmptiesTheList)
{
    deliver(0x5137, RecordBuilder(0x5137, 29));
    EXPECT_EQ(display(), "[]");
}

TEST_F(NeighboringCellsTest, MeasurementOneByteTooShortLeavesTheList)
{
    deliver(0x5137, RecordBuilder(0x5137, 28));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(NeighboringCellsTest, NeighboursPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x5137, measured({{50, 31, 12}}).u8(28, 2));
    EXPECT_EQ(display(),
        "[{\"ARFCN\": \"50\", \"RSSI\": \"31\", \"C1 Value\": \"12\"}, "
        "{\"ARFCN\": \"0\", \"RSSI\": \"0\", \"C1 Value\": \"0\"}]");
}

TEST_F(NeighboringCellsTest, LevelsOfTheCellInformationAreDoubled)
{
    deliverPropertyList(0xFF0001, List::make({neighbour(62, -45), neighbour(63, 32767)}));
    EXPECT_EQ(display(), "[{\"ARFCN\": \"62\", \"RSSI\": \"-90 dBm\"}, {\"ARFCN\": \"63\", \"RSSI\": \"\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(NeighboringCellsTest, OnlyGSMNeighboursOfTheCellInformationAreListed)
{
    auto serving = neighbour(1, -1);
    serving->set(kRKCellMonitorCellType, kRKCellMonitorCellTypeServing);
    auto umts = neighbour(2, -2);
    umts->set(kRKCellMonitorCellRadioAccessTechnology, kRKCellMonitorRadioAccessTechnologyUMTS);
    deliverPropertyList(0xFF0001, List::make({serving, umts}));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(NeighboringCellsTest, NeighbourWithoutAnyNumberIsListedWithoutKeysAndEachIsLogged)
{
    deliverPropertyList(0xFF0001,
        List::make({informationOfCell(kRKCellMonitorRadioAccessTechnologyGSM, kRKCellMonitorCellTypeNeighbor, {})}));
    EXPECT_EQ(display(), "[{}]");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>NeighboringCells: Failed to retrieve ARFCN\n\n<3>NeighboringCells: Failed to retrieve RSSI\n\n");
}

TEST_F(NeighboringCellsTest, PayloadThatDoesNotParseEmptiesTheListAndIsLoggedTwice)
{
    deliver(0xFF0001, RecordBuilder(0xFF0001, 20));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(),
        std::string(Trace) + "<3>Cell Info Array data could not be constructed\n<3>Failed to get Cell Array\n\n");
}

TEST_F(NeighboringCellsTest, OtherCodeIsLoggedAsUnknownAndLeavesTheList)
{
    deliver(0x5134, RecordBuilder(0x5134, 60));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 20788\n");
}

} // namespace
} // namespace spectrel
