#include "Sections/UTRAN/UTRANServingCellInfo.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xD0E2;
constexpr const char* Trace = "<4>Serving Cell Info\n";

class UTRANServingCellInfoTest : public SectionFixture<UTRANServingCellInfo> {
protected:
    UTRANServingCellInfoTest()
        : SectionFixture(Dictionary::make())
    {
    }
    static RecordBuilder servingCell()
    {
        return RecordBuilder(Code, 26)
            .u8(14, 3)
            .u8(15, 7)
            .u8(16, 0xEE)
            .u16(17, 9700)
            .u16(19, 10650)
            .u32(21, 0x0ABCDEF)
            .u8(25, 2);
    }
    static DictionaryRef cell(int identity, std::string_view technology = kRKCellMonitorRadioAccessTechnologyUTRAN2,
        std::string_view type = kRKCellMonitorCellTypeServing)
    {
        return Dictionary::make({
            {std::string(kRKCellMonitorCellRadioAccessTechnology), technology},
            {std::string(kRKCellMonitorCellType), type},
            {std::string(kRKCellMonitorLAC), Value::integer(12)},
            {std::string(kRKCellMonitorCellId), Value::integer(identity)},
            {std::string(kRKCellMonitorBandInfo), Value::integer(1)},
            {std::string(kRKCellMonitorSCN), Value::integer(88)},
            {std::string(kRKCellMonitorUARFCN), Value::integer(10700)},
        });
    }
};

TEST_F(UTRANServingCellInfoTest, RecordOf26BytesSetsSixKeysInOrder)
{
    deliver(Code, servingCell());
    EXPECT_EQ(display(),
        "{\"Cell Access Restrictions\": \"3\", \"Cell ID\": \"11259375\", \"Downlink UARFCN\": \"10650\", "
        "\"Uplink UARFCN\": \"9700\", \"URA ID\": \"7\", \"Allowed Access\": \"All Calls\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UTRANServingCellInfoTest, RecordOf25BytesChangesNothing)
{
    deliver(Code, servingCell().shrink(25));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UTRANServingCellInfoTest, LowestBitOfTheAccessByteDecides)
{
    deliver(Code, servingCell().u8(25, 0x03));
    EXPECT_EQ(shown("Allowed Access"), "\"Emergency Calls Only\"");
    deliver(Code, servingCell().u8(25, 0x02));
    EXPECT_EQ(shown("Allowed Access"), "\"All Calls\"");
}

TEST_F(UTRANServingCellInfoTest, EveryBitShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Cell Access Restrictions", 14, 0, 8, plain},
            {"Cell ID", 21, 0, 32, plain},
            {"Downlink UARFCN", 19, 0, 16, plain},
            {"Uplink UARFCN", 17, 0, 16, plain},
            {"URA ID", 15, 0, 8, plain},
            {"Allowed Access", 25, 0, 1,
                [](unsigned raw) { return std::string(raw ? "Emergency Calls Only" : "All Calls"); }},
        },
        [this](const Bytes& record) {
            deliver(Code, record);
            return display();
        });
    sweep.run(RecordBuilder(Code, 30).bytes(), 13, 30);
}

TEST_F(UTRANServingCellInfoTest, CellInformationSetsSixKeysInOrder)
{
    deliverPropertyList(0xFF0001, List::make({cell(5)}));
    EXPECT_EQ(display(),
        "{\"Local Area Code\": \"12\", \"Cell ID\": \"5\", \"Freq Band Indicator\": \"1\", "
        "\"Cell Scrambling Code\": \"88\", \"Uplink UARFCN\": \"10700\", \"Downlink UARFCN\": \"10700\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UTRANServingCellInfoTest, RecordAfterCellInformationTellsTheChannelsApart)
{
    deliverPropertyList(0xFF0001, List::make({cell(5)}));
    deliver(Code, servingCell());
    EXPECT_EQ(shown("Uplink UARFCN"), "\"9700\"");
    EXPECT_EQ(shown("Downlink UARFCN"), "\"10650\"");
    EXPECT_EQ(shown("Local Area Code"), "\"12\"");
}

TEST_F(UTRANServingCellInfoTest, LastOfTwoServingCellsRemains)
{
    deliverPropertyList(0xFF0001, List::make({cell(5), cell(6)}));
    EXPECT_EQ(shown("Cell ID"), "\"6\"");
}

TEST_F(UTRANServingCellInfoTest, WhatTheLastServingCellLacksRemainsFromTheOneBefore)
{
    auto last = cell(6);
    last->remove(kRKCellMonitorLAC);
    last->set(kRKCellMonitorUARFCN, "text");
    deliverPropertyList(0xFF0001, List::make({cell(5), last}));
    EXPECT_EQ(display(),
        "{\"Local Area Code\": \"12\", \"Cell ID\": \"6\", \"Freq Band Indicator\": \"1\", "
        "\"Cell Scrambling Code\": \"88\", \"Uplink UARFCN\": \"10700\", \"Downlink UARFCN\": \"10700\"}");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>Serving Cell Info: Failed to retrieve LAC\n\n"
              "<3>Serving Cell Info: Failed to retrieve UARFCN\n\n");
}

TEST_F(UTRANServingCellInfoTest, EachMissingKeyHasItsOwnLineOnce)
{
    deliverPropertyList(0xFF0001,
        List::make({Dictionary::make({
            {std::string(kRKCellMonitorCellRadioAccessTechnology), kRKCellMonitorRadioAccessTechnologyUTRAN2},
            {std::string(kRKCellMonitorCellType), kRKCellMonitorCellTypeServing},
        })}));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>Serving Cell Info: Failed to retrieve LAC\n\n"
              "<3>Serving Cell Info: Failed to retrieve Cell ID\n\n"
              "<3>Serving Cell Info: Failed to retrieve Freq Band Indicator\n\n"
              "<3>Serving Cell Info: Failed to retrieve Cell Scrambling Code\n\n"
              "<3>Serving Cell Info: Failed to retrieve UARFCN\n\n");
}

TEST_F(UTRANServingCellInfoTest, OtherTechnologiesNeighboursAndTypelessEntriesChangeNothing)
{
    auto typeless = cell(4);
    typeless->remove(kRKCellMonitorCellType);
    deliverPropertyList(0xFF0001,
        List::make({cell(1, kRKCellMonitorRadioAccessTechnologyLTE), cell(2, kRKCellMonitorRadioAccessTechnologyGSM),
            cell(3, kRKCellMonitorRadioAccessTechnologyUTRAN2, kRKCellMonitorCellTypeNeighbor), typeless, "text"}));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UTRANServingCellInfoTest, NothingToReadIsSilentButForTheReader)
{
    deliverPropertyList(0xFF0001, List::make());
    deliverPropertyList(0xFF0001, cell(5));
    EXPECT_EQ(log(), std::string(Trace) + Trace);
    const Bytes garbage {'g', 'a', 'r'};
    deliver(0xFF0001, RecordBuilder::withPayload(0xFF0001, garbage));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Cell Info Array data could not be constructed\n");
}

TEST_F(UTRANServingCellInfoTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(0xD0E0, RecordBuilder(0xD0E0, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

} // namespace
} // namespace spectrel
