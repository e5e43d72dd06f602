#include "Sections/GSMUMTS/UMTS/UMTSSet.h"

#include "Tests/Sections/CellInformation.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class UMTSSetTest : public SectionFixture<UMTSSet> {
protected:
    UMTSSetTest()
        : SectionFixture(List::make({"old"}))
    {
    }

    static RecordBuilder oneCell()
    {
        return RecordBuilder(0x4005, 25)
            .u8(13, 1)
            .u16(15, 10700)
            .u16(17, 511)
            .u8(19, 0x100 - 80)
            .u16(20, 0x10000 - 95)
            .u8(22, 0x100 - 15)
            .u16(23, 0x10000 - 7);
    }
    static DictionaryRef neighbour(std::int64_t code,
        std::string_view technology = kRKCellMonitorRadioAccessTechnologyUMTS,
        std::string_view type = kRKCellMonitorCellTypeNeighbor)
    {
        return informationOfCell(technology, type,
            {{kRKCellMonitorUARFCN, 10700}, {kRKCellMonitorSCN, code}, {kRKCellMonitorRSCP, -85},
                {kRKCellMonitorECN0, -9}});
    }
};

constexpr const char* Trace = "<4>UMTSSet\n";

TEST_F(UMTSSetTest, SubscribesToItsTwoCodes)
{
    EXPECT_EQ(section.getSectionName(), "UMTS Set");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x4005, 0xFF0001}));
}

TEST_F(UMTSSetTest, RankedCellsAreListedWithTheirKeysInOrder)
{
    deliver(0x4005, oneCell());
    EXPECT_EQ(display(),
        "[{\"Scrambling Code\": \"511\", \"RSCP\": \"-101 dB\", \"Energy Per Chip\": \"-7.500000 dB\", "
        "\"Downlink Frequency\": \"10700\", \"Ranking Value\": \"-7\", \"Rank Cell RSCP\": \"-95 dB\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSSetTest, OneUMTSAndOneGSMCellGiveOneUMTSCell)
{
    Bytes bytes = oneCell().u8(14, 1).bytes();
    bytes.resize(25 + 7, 0xEE);
    deliver(0x4005, bytes);
    EXPECT_EQ(display(),
        "[{\"Scrambling Code\": \"511\", \"RSCP\": \"-101 dB\", \"Energy Per Chip\": \"-7.500000 dB\", "
        "\"Downlink Frequency\": \"10700\", \"Ranking Value\": \"-7\", \"Rank Cell RSCP\": \"-95 dB\"}]");
}

TEST_F(UMTSSetTest, EnergyIsShownInHalvesWithSixDecimalsAndRSCPFrom21Down)
{
    const struct {
        int raw;
        const char* rscp;
        const char* energy;
    } rows[] = {{-15, "-36 dB", "-7.500000 dB"}, {-80, "-101 dB", "-40.000000 dB"}, {-1, "-22 dB", "-0.500000 dB"},
        {0, "-21 dB", "0.000000 dB"}, {127, "106 dB", "63.500000 dB"}, {-128, "-149 dB", "-64.000000 dB"}};
    for (const auto& [raw, rscp, energy] : rows) {
        const auto byte = static_cast<std::uint8_t>(raw);
        deliver(0x4005, oneCell().u8(19, byte).u8(22, byte));
        EXPECT_NE(display().find(std::string("\"RSCP\": \"") + rscp + "\", \"Energy Per Chip\": \"" + energy + "\""),
            std::string::npos)
            << display();
    }
}

TEST_F(UMTSSetTest, DownlinkFrequencyIsSignedAndScramblingCodeIsNot)
{
    deliver(0x4005, oneCell().u16(15, 0xFFFF).u16(17, 0xFFFF));
    EXPECT_NE(display().find("\"Scrambling Code\": \"65535\""), std::string::npos);
    EXPECT_NE(display().find("\"Downlink Frequency\": \"-1\""), std::string::npos);
}

TEST_F(UMTSSetTest, NoRankedCellsEmptyTheList)
{
    deliver(0x4005, RecordBuilder(0x4005, 15).u8(14, 3));
    EXPECT_EQ(display(), "[]");
}

TEST_F(UMTSSetTest, RankedRecordOneByteTooShortLeavesTheList)
{
    deliver(0x4005, RecordBuilder(0x4005, 14));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSSetTest, CellsPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x4005, RecordBuilder(0x4005, 15).u8(13, 1));
    EXPECT_EQ(display(),
        "[{\"Scrambling Code\": \"0\", \"RSCP\": \"-21 dB\", \"Energy Per Chip\": \"0.000000 dB\", "
        "\"Downlink Frequency\": \"0\", \"Ranking Value\": \"0\", \"Rank Cell RSCP\": \"0 dB\"}]");
}

TEST_F(UMTSSetTest, NeighboursOfTheCellInformationAreListedInItsOrder)
{
    deliverPropertyList(
        0xFF0001, List::make({neighbour(20), neighbour(3, kRKCellMonitorRadioAccessTechnologyGSM), neighbour(10)}));
    EXPECT_EQ(display(),
        "[{\"UARFCN\": \"10700\", \"Scrambling Code\": \"20\", \"RSCP\": \"-85 dBm\", "
        "\"Energy Per Chip\": \"-9 dB\"}, "
        "{\"UARFCN\": \"10700\", \"Scrambling Code\": \"10\", \"RSCP\": \"-85 dBm\", "
        "\"Energy Per Chip\": \"-9 dB\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSSetTest, WhatWasNotMeasuredIsEmpty)
{
    auto cell = neighbour(20);
    cell->set(kRKCellMonitorRSCP, Value::integer(32767));
    deliverPropertyList(0xFF0001, List::make({cell}));
    EXPECT_EQ(display(),
        "[{\"UARFCN\": \"10700\", \"Scrambling Code\": \"20\", \"RSCP\": \"\", \"Energy Per Chip\": \"-9 dB\"}]");
    cell->set(kRKCellMonitorECN0, Value::integer(32767));
    cell->set(kRKCellMonitorRSCP, Value::integer(-32767));
    deliverPropertyList(0xFF0001, List::make({cell}));
    EXPECT_EQ(display(),
        "[{\"UARFCN\": \"10700\", \"Scrambling Code\": \"20\", \"RSCP\": \"-32767 dBm\", "
        "\"Energy Per Chip\": \"\"}]");
}

TEST_F(UMTSSetTest, OnlyLTEAndServingCellsEmptyTheList)
{
    deliverPropertyList(0xFF0001,
        List::make({neighbour(1, kRKCellMonitorRadioAccessTechnologyLTE),
            neighbour(2, kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeServing)}));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSSetTest, NeighbourWithoutAnyNumberIsListedWithoutKeysAndEachIsLogged)
{
    deliverPropertyList(0xFF0001,
        List::make({informationOfCell(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeNeighbor, {})}));
    EXPECT_EQ(display(), "[{}]");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>UMTSSet: Failed to retrieve UARFCN\n\n<3>UMTSSet: Failed to retrieve Scrambling Code\n\n"
              "<3>UMTSSet: Failed to retrieve RSCP\n\n<3>UMTSSet: Failed to retrieve Energy Per Chip\n\n");
}

TEST_F(UMTSSetTest, CellsWithoutTechnologyOrTypeAreSkipped)
{
    auto typeless = neighbour(1);
    typeless->remove(kRKCellMonitorCellType);
    auto technologyless = neighbour(2);
    technologyless->remove(kRKCellMonitorCellRadioAccessTechnology);
    deliverPropertyList(0xFF0001, List::make({typeless, technologyless, "text"}));
    EXPECT_EQ(display(), "[]");
}

TEST_F(UMTSSetTest, PayloadThatDoesNotParseEmptiesTheListAndIsLoggedTwice)
{
    deliver(0xFF0001, RecordBuilder(0xFF0001, 20));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(),
        std::string(Trace) + "<3>Cell Info Array data could not be constructed\n<3>Failed to get Cell Array\n\n");
}

TEST_F(UMTSSetTest, PayloadThatIsNoListEmptiesTheList)
{
    deliverPropertyList(0xFF0001, neighbour(1));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSSetTest, NodeThatIsNoListTakesNothingButTheLinesAreLogged)
{
    section.updateSectionRef({});
    log();
    deliver(0x4005, oneCell());
    deliverPropertyList(0xFF0001,
        List::make({informationOfCell(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeNeighbor, {})}));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_NE(log().find("UMTSSet: Failed to retrieve RSCP"), std::string::npos);
}

TEST_F(UMTSSetTest, OtherCodeIsLoggedAsUnknownAndLeavesTheList)
{
    deliver(0x417A, RecordBuilder(0x417A, 40));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 16762\n");
}

} // namespace
} // namespace spectrel
