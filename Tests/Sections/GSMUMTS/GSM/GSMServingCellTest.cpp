#include "Sections/GSMUMTS/GSM/GSMServingCell.h"

#include "Tests/Sections/CellInformation.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class GSMServingCellTest : public SectionFixture<GSMServingCell> {
protected:
    GSMServingCellTest()
        : SectionFixture(Dictionary::make())
    {
    }

    static DictionaryRef servingCell(std::int64_t identity)
    {
        return informationOfCell(kRKCellMonitorRadioAccessTechnologyGSM, kRKCellMonitorCellTypeServing,
            {{kRKCellMonitorCellId, identity}, {kRKCellMonitorARFCN, 77}});
    }
};

constexpr const char* Trace = "<4>GSMServingCell\n";

TEST_F(GSMServingCellTest, SubscribesToItsFourCodes)
{
    EXPECT_EQ(section.getSectionName(), "GSM Serving Cell");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x5134, 0x5137, 0x5076, 0xFF0001}));
}

TEST_F(GSMServingCellTest, IdentityOf25BytesChangesNothingAndOneOf26IsShownInOrder)
{
    deliver(0x5134, RecordBuilder(0x5134, 25).u16(13, 62).u16(15, 41).u16(17, 65535));
    EXPECT_EQ(display(), "{}");
    deliver(0x5134, RecordBuilder(0x5134, 26).u16(13, 62).u16(15, 41).u16(17, 65535));
    EXPECT_EQ(display(), "{\"Cell ID\": \"65535\", \"ARFCN\": \"62\", \"BSIC\": \"41\"}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(GSMServingCellTest, OfTheDedicatedChannelOnlyTheLowByteIsShown)
{
    deliver(0x5076, RecordBuilder(0x5076, 16).u8(13, 0x2C).u8(14, 0x01));
    EXPECT_EQ(display(), "{}");
    deliver(0x5076, RecordBuilder(0x5076, 17).u8(13, 0x2C).u8(14, 0x01));
    EXPECT_EQ(display(), "{\"MA Dedicated ARFCN\": \"44\"}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(GSMServingCellTest, MeasurementIsShownInOrderWithTheLowHalvesOfItsCriteria)
{
    deliver(0x5137, RecordBuilder(0x5137, 29).u8(15, 200).u32(16, 0x12348001).u32(20, 0x5678FFFE));
    EXPECT_EQ(display(), "{\"RSSI\": \"200 dBm\", \"C1 Value\": \"32769\", \"C2 Value\": \"65534\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GSMServingCellTest, MeasurementOf28BytesChangesNothing)
{
    deliver(0x5137, RecordBuilder(0x5137, 28).u8(15, 200));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GSMServingCellTest, NumbersOfItsRecordsAreUnsigned)
{
    deliver(0x5134, RecordBuilder(0x5134, 26).u16(13, 65533).u16(15, 65534).u16(17, 65535));
    EXPECT_EQ(display(), "{\"Cell ID\": \"65535\", \"ARFCN\": \"65533\", \"BSIC\": \"65534\"}");
    deliver(0x5076, RecordBuilder(0x5076, 17).u16(13, 0xFFFE));
    EXPECT_EQ(shown("MA Dedicated ARFCN"), "\"254\"");
}

TEST_F(GSMServingCellTest, FirstServingGSMCellOfTheCellInformationIsShown)
{
    const auto umts = informationOfCell(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeServing,
        {{kRKCellMonitorCellId, 1}, {kRKCellMonitorARFCN, 1}});
    deliverPropertyList(0xFF0001, List::make({umts, servingCell(123456), servingCell(2)}));
    EXPECT_EQ(display(), "{\"Cell ID\": \"123456\", \"ARFCN\": \"77\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GSMServingCellTest, MissingNumbersAreLoggedAndLeaveTheirKeys)
{
    deliverPropertyList(0xFF0001, List::make({servingCell(5)}));
    log();
    auto cell = servingCell(6);
    cell->remove(kRKCellMonitorCellId);
    cell->set(kRKCellMonitorARFCN, "77");
    deliverPropertyList(0xFF0001, List::make({cell}));
    EXPECT_EQ(display(), "{\"Cell ID\": \"5\", \"ARFCN\": \"77\"}");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>GSMServingCell: Failed to retrieve Cell ID\n\n<3>GSMServingCell: Failed to retrieve ARFCN\n\n");
}

TEST_F(GSMServingCellTest, NoMatchingCellChangesNothing)
{
    deliverPropertyList(0xFF0001, List::make());
    auto neighbour = servingCell(5);
    neighbour->set(kRKCellMonitorCellType, kRKCellMonitorCellTypeNeighbor);
    deliverPropertyList(0xFF0001, List::make({neighbour}));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(GSMServingCellTest, PayloadThatDoesNotParseIsLoggedTwice)
{
    deliver(0xFF0001, RecordBuilder(0xFF0001, 20));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(),
        std::string(Trace) + "<3>Cell Info Array data could not be constructed\n<3>Failed to get Cell Array\n\n");
}

TEST_F(GSMServingCellTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x5138, RecordBuilder(0x5138, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 20792\n");
}

} // namespace
} // namespace spectrel
