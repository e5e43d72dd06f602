#include "Sections/GSMUMTS/UMTS/UMTSRRInfo.h"

#include "Tests/Sections/CellInformation.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class UMTSRRInfoTest : public SectionFixture<UMTSRRInfo> {
protected:
    UMTSRRInfoTest()
        : SectionFixture(Dictionary::make())
    {
    }

    static RecordBuilder powers(const std::vector<std::int16_t>& raw)
    {
        RecordBuilder record(0x4031, 16 + 14 * raw.size());
        record.u8(14, static_cast<std::uint32_t>(raw.size()));
        for (std::size_t i = 0; i < raw.size(); ++i)
            record.u16(16 + 14 * i + 4, static_cast<std::uint16_t>(raw[i]));
        return record;
    }
    static RecordBuilder servingCell(std::size_t size = 29)
    {
        return RecordBuilder(0x4127, size).u32(13, 9750).u32(17, 10700).u32(21, 0x0FFFFFFF).u16(25, 0xFFFF);
    }
    static DictionaryRef cell(std::int64_t identity)
    {
        return informationOfCell(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeServing,
            {{kRKCellMonitorCellId, identity}, {kRKCellMonitorUARFCN, 10725}, {kRKCellMonitorSCN, 300}});
    }
};

constexpr const char* Trace = "<4>UMTSRRInfo\n";

TEST_F(UMTSRRInfoTest, SubscribesToItsFiveCodes)
{
    EXPECT_EQ(section.getSectionName(), "UMTS RR Info");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x4125, 0x4031, 0x4127, 0x4157, 0xFF0001}));
}

TEST_F(UMTSRRInfoTest, StateThreeIsCellDCHAndSixIsUnknown)
{
    deliver(0x4125, RecordBuilder(0x4125, 14).u8(13, 3));
    EXPECT_EQ(display(), "{\"RRC State\": \"CELL_DCH\"}");
    deliver(0x4125, RecordBuilder(0x4125, 14).u8(13, 6));
    EXPECT_EQ(display(), "{\"RRC State\": \"Unknown\"}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(UMTSRRInfoTest, EveryRRCStateHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x4125, RecordBuilder(0x4125, 14), 13, "RRC State"),
        textsForEachByte({"Disconnected", "Connecting", "CELL_FACH", "CELL_DCH", "CELL_PCH", "URA_PCH"}, "Unknown"));
}

TEST_F(UMTSRRInfoTest, StateOneByteTooShortChangesNothing)
{
    deliver(0x4125, RecordBuilder(0x4125, 13));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSRRInfoTest, TransmitPowerIsTheMeanOfTheSamples)
{
    deliver(0x4031, powers({88, 0}));
    EXPECT_EQ(display(), "{\"Transmit Power\": \"-10.00 dBm\"}");
    deliver(0x4031, powers({88, 0, 98, 98})); // -10, -9, -9
    EXPECT_EQ(display(), "{\"Transmit Power\": \"-9.33 dBm\"}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(UMTSRRInfoTest, EachSampleIsDividedTowardsZero)
{
    deliver(0x4031, powers({-1000})); // -488 / 10 is -48
    EXPECT_EQ(display(), "{\"Transmit Power\": \"-118.00 dBm\"}");
    deliver(0x4031, powers({209})); // 721 / 10 is 72
    EXPECT_EQ(display(), "{\"Transmit Power\": \"2.00 dBm\"}");
    deliver(0x4031, powers({-32768, 32767})); // -3295 and 3257
    EXPECT_EQ(display(), "{\"Transmit Power\": \"-19.00 dBm\"}");
}

TEST_F(UMTSRRInfoTest, NoSamplesAreNotANumber)
{
    deliver(0x4031, powers({}));
    EXPECT_EQ(display(), "{\"Transmit Power\": \" nan dBm\"}");
    deliver(0x4031, powers({0, 0, 0}));
    EXPECT_EQ(display(), "{\"Transmit Power\": \" nan dBm\"}");
}

TEST_F(UMTSRRInfoTest, SamplesPastTheEndOfTheRecordDoNotCount)
{
    deliver(0x4031, powers({88}).u8(14, 255));
    EXPECT_EQ(display(), "{\"Transmit Power\": \"-10.00 dBm\"}");
}

TEST_F(UMTSRRInfoTest, TransmitPowerOneByteTooShortChangesNothing)
{
    deliver(0x4031, RecordBuilder(0x4031, 15));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSRRInfoTest, ServingCellIsShownInOrder)
{
    deliver(0x4127, servingCell());
    EXPECT_EQ(display(),
        "{\"Cell ID\": \"268435455\", \"Downlink Frequency\": \"10700\", \"Uplink Frequency\": \"9750\", "
        "\"URA ID\": \"65535\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSRRInfoTest, ServingCellOf28BytesChangesNothingAndOneOf29RemovesUARFCN)
{
    deliverPropertyList(0xFF0001, List::make({cell(5)}));
    const std::string before = display();
    deliver(0x4127, servingCell(28));
    EXPECT_EQ(display(), before);
    deliver(0x4127, servingCell(29));
    EXPECT_EQ(display(),
        "{\"Cell ID\": \"268435455\", \"Scrambling Code\": \"300\", \"Downlink Frequency\": \"10700\", "
        "\"Uplink Frequency\": \"9750\", \"URA ID\": \"65535\"}");
}

TEST_F(UMTSRRInfoTest, FieldsOf32BitsShowTheirBitsAsSigned)
{
    deliver(0x4127, servingCell().u32(13, 0xFFFFFFFF).u32(17, 0x80000000).u32(21, 0xFFFFFFFE));
    EXPECT_EQ(shown("Uplink Frequency"), "\"-1\"");
    EXPECT_EQ(shown("Downlink Frequency"), "\"-2147483648\"");
    EXPECT_EQ(shown("Cell ID"), "\"-2\"");
}

TEST_F(UMTSRRInfoTest, CipheringIsEnabledForAnythingButZero)
{
    deliver(0x4157, RecordBuilder(0x4157, 18).u8(13, 1));
    EXPECT_EQ(display(), "{}");
    deliver(0x4157, RecordBuilder(0x4157, 19).u8(13, 2));
    EXPECT_EQ(display(), "{\"Ciphering\": \"Enabled\"}");
    EXPECT_EQ(shownForEachByte(0x4157, RecordBuilder(0x4157, 19), 13, "Ciphering"),
        textsForEachByte({"Disabled"}, "Enabled"));
}

TEST_F(UMTSRRInfoTest, CellInformationIsShownInOrder)
{
    deliverPropertyList(0xFF0001,
        List::make({informationOfCell(kRKCellMonitorRadioAccessTechnologyGSM, kRKCellMonitorCellTypeServing, {}),
            cell(5), cell(6)}));
    EXPECT_EQ(display(), "{\"Cell ID\": \"5\", \"UARFCN\": \"10725\", \"Scrambling Code\": \"300\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UMTSRRInfoTest, EachMissingNumberHasItsOwnLine)
{
    deliverPropertyList(0xFF0001,
        List::make({informationOfCell(kRKCellMonitorRadioAccessTechnologyUMTS, kRKCellMonitorCellTypeServing, {})}));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>UMTSRRInfo: Failed to retrieve Cell ID\n\n<3>UMTSRRInfo: Failed to retrieve UARFCN\n\n"
              "<3>UMTSRRInfo: Failed to retrieve Scrambling Code\n\n");
}

TEST_F(UMTSRRInfoTest, NoMatchingCellChangesNothing)
{
    auto neighbour = cell(5);
    neighbour->set(kRKCellMonitorCellType, kRKCellMonitorCellTypeNeighbor);
    deliverPropertyList(0xFF0001, List::make({neighbour}));
    deliverPropertyList(0xFF0001, List::make());
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(UMTSRRInfoTest, PayloadThatDoesNotParseIsLoggedTwice)
{
    deliver(0xFF0001, RecordBuilder(0xFF0001, 20));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(),
        std::string(Trace) + "<3>Cell Info Array data could not be constructed\n<3>Failed to get Cell Array\n\n");
}

TEST_F(UMTSRRInfoTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x4126, RecordBuilder(0x4126, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 16678\n");
}

} // namespace
} // namespace spectrel
