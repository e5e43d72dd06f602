#include "Sections/LTE/LTEServingCellInfo.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"
#include "Values/List.h"

#include <map>

namespace spectrel {
namespace {

class LTEServingCellInfoTest : public SectionFixture<LTEServingCellInfo> {
protected:
    LTEServingCellInfoTest()
        : SectionFixture(Dictionary::make())
    {
    }

    static RecordBuilder servingCell(std::size_t size = 38)
    {
        return RecordBuilder(0xB0C2, std::max<std::size_t>(size, 38))
            .u16(14, 503)
            .u16(16, 1300)
            .u16(18, 19300)
            .u8(20, 100)
            .u8(21, 50)
            .u32(22, 0x01234567)
            .u16(26, 65534)
            .u32(28, 3)
            .shrink(size);
    }
    static DictionaryRef cell(int identity, std::string_view type = kRKCellMonitorCellTypeServing)
    {
        return Dictionary::make({
            {std::string(kRKCellMonitorCellRadioAccessTechnology), kRKCellMonitorRadioAccessTechnologyLTE},
            {std::string(kRKCellMonitorCellType), type},
            {std::string(kRKCellMonitorTAC), Value::integer(12)},
            {std::string(kRKCellMonitorCellId), Value::integer(identity)},
            {std::string(kRKCellMonitorPID), Value::integer(77)},
            {std::string(kRKCellMonitorBandInfo), Value::integer(20)},
            {std::string(kRKCellMonitorUARFCN), Value::integer(6300)},
        });
    }
};

constexpr const char* Trace = "<4>LTE Serving Cell Info\n";

TEST_F(LTEServingCellInfoTest, RecordOneByteTooShortChangesNothing)
{
    deliver(0xB0C2, servingCell(37));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(LTEServingCellInfoTest, RecordOf38BytesSetsAllEightKeysAndRemovesUARFCN)
{
    deliverPropertyList(0xFF0001, List::make({cell(5)}));
    EXPECT_EQ(shown("UARFCN"), "\"6300\"");
    log();
    deliver(0xB0C2, servingCell(38));
    EXPECT_EQ(display(),
        "{\"Tracking Area Code\": \"65534\", \"Cell Identity\": \"19088743\", \"Physical Cell ID\": \"503\", "
        "\"Freq Band Indicator\": \"3\", \"Download Frequency\": \"1300\", \"Upload Frequency\": \"19300\", "
        "\"Download Bandwidth\": \"20 MHz\", \"Upload Bandwidth\": \"10 MHz\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(LTEServingCellInfoTest, KeysAreWrittenInOrder)
{
    deliver(0xB0C2, servingCell());
    EXPECT_EQ(display(),
        "{\"Physical Cell ID\": \"503\", \"Download Frequency\": \"1300\", \"Upload Frequency\": \"19300\", "
        "\"Download Bandwidth\": \"20 MHz\", \"Upload Bandwidth\": \"10 MHz\", \"Cell Identity\": \"19088743\", "
        "\"Tracking Area Code\": \"65534\", \"Freq Band Indicator\": \"3\"}");
}

std::string bandwidth(unsigned resourceBlocks)
{
    static const std::map<unsigned, const char*> names {
        {6, "1.4 MHz"}, {15, "3 MHz"}, {25, "5 MHz"}, {50, "10 MHz"}, {75, "15 MHz"}, {100, "20 MHz"}};
    const auto name = names.find(resourceBlocks);
    return name == names.end() ? "Unknown" : name->second;
}

TEST_F(LTEServingCellInfoTest, EveryBitShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Physical Cell ID", 14, 0, 16, plain},
            {"Download Frequency", 16, 0, 16, plain},
            {"Upload Frequency", 18, 0, 16, plain},
            {"Download Bandwidth", 20, 0, 8, bandwidth},
            {"Upload Bandwidth", 21, 0, 8, bandwidth},
            {"Cell Identity", 22, 0, 32, plain},
            {"Tracking Area Code", 26, 0, 16, plain},
            {"Freq Band Indicator", 28, 0, 32, plain},
        },
        [this](const Bytes& record) {
            deliver(0xB0C2, record);
            return display();
        });
    sweep.run(RecordBuilder(0xB0C2, 42).bytes(), 13, 42);
}

TEST_F(LTEServingCellInfoTest, EveryBitOfTheAntennasShowsAndNoOther)
{
    const BitSweep sweep({{"Num Tx Antennas", 20, 0, 8, plain}}, [this](const Bytes& record) {
        deliver(0xB0C1, record);
        return display();
    });
    sweep.run(RecordBuilder(0xB0C1, 26).bytes(), 13, 26);
}

TEST_F(LTEServingCellInfoTest, EveryBandwidthByteIsNamedOrUnknown)
{
    for (unsigned byte = 0; byte < 256; ++byte) {
        deliver(0xB0C2, servingCell().u8(20, byte).u8(21, 255 - byte));
        EXPECT_EQ(shown("Download Bandwidth"), "\"" + bandwidth(byte) + "\"") << byte;
        EXPECT_EQ(shown("Upload Bandwidth"), "\"" + bandwidth(255 - byte) + "\"") << byte;
    }
}

TEST_F(LTEServingCellInfoTest, FieldsOf32BitsShowTheirBitsAsSigned)
{
    deliver(0xB0C2, servingCell().u32(22, 0xFFFFFFFF).u32(28, 0x80000000));
    EXPECT_EQ(shown("Cell Identity"), "\"-1\"");
    EXPECT_EQ(shown("Freq Band Indicator"), "\"-2147483648\"");
}

TEST_F(LTEServingCellInfoTest, AntennasOf22BytesAreSetAndStillLogTheUnknownMessage)
{
    deliver(0xB0C1, RecordBuilder(0xB0C1, 22).u8(20, 2));
    EXPECT_EQ(display(), "{\"Num Tx Antennas\": \"2\"}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 45249\n");
}

TEST_F(LTEServingCellInfoTest, AntennasOf21BytesChangeNothingAndLogNothingMore)
{
    deliver(0xB0C1, RecordBuilder(0xB0C1, 21).u8(20, 2));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(LTEServingCellInfoTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0xB0C3, RecordBuilder(0xB0C3, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 45251\n");
}

TEST_F(LTEServingCellInfoTest, CellInformationSetsFiveKeysInOrder)
{
    deliverPropertyList(0xFF0001, List::make({cell(5)}));
    EXPECT_EQ(display(),
        "{\"Tracking Area Code\": \"12\", \"Cell Identity\": \"5\", \"Physical Cell ID\": \"77\", "
        "\"Freq Band Indicator\": \"20\", \"UARFCN\": \"6300\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(LTEServingCellInfoTest, OnlyANeighbourChangesNothing)
{
    deliverPropertyList(0xFF0001, List::make({cell(5, kRKCellMonitorCellTypeNeighbor)}));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(LTEServingCellInfoTest, FirstOfTwoServingCellsCounts)
{
    deliverPropertyList(0xFF0001, List::make({cell(4, kRKCellMonitorCellTypeNeighbor), cell(5), cell(6)}));
    EXPECT_EQ(shown("Cell Identity"), "\"5\"");
}

TEST_F(LTEServingCellInfoTest, MissingTACIsLoggedAndTheOtherFourAreSet)
{
    auto serving = cell(5);
    serving->remove(kRKCellMonitorTAC);
    deliverPropertyList(0xFF0001, List::make({serving}));
    EXPECT_EQ(display(),
        "{\"Cell Identity\": \"5\", \"Physical Cell ID\": \"77\", \"Freq Band Indicator\": \"20\", "
        "\"UARFCN\": \"6300\"}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Serving Cell Info: Failed to retrieve TAC\n\n");
}

TEST_F(LTEServingCellInfoTest, EachMissingKeyHasItsOwnLine)
{
    deliverPropertyList(0xFF0001,
        List::make({Dictionary::make({
            {std::string(kRKCellMonitorCellRadioAccessTechnology), kRKCellMonitorRadioAccessTechnologyLTE},
            {std::string(kRKCellMonitorCellType), kRKCellMonitorCellTypeServing},
        })}));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(),
        std::string(Trace)
            + "<3>Serving Cell Info: Failed to retrieve TAC\n\n"
              "<3>Serving Cell Info: Failed to retrieve Cell ID\n\n"
              "<3>Serving Cell Info: Failed to retrieve Physical Cell ID\n\n"
              "<3>Serving Cell Info: Failed to retrieve Freq Band Indicator\n\n"
              "<3>Serving Cell Info: Failed to retrieve UARFCN\n\n");
}

TEST_F(LTEServingCellInfoTest, OnlyWholeNumbersOf32BitsRead)
{
    auto serving = cell(5);
    serving->set(kRKCellMonitorTAC, "12");
    serving->set(kRKCellMonitorCellId, Value::integer(0x80000000LL));
    serving->set(kRKCellMonitorPID, Value::real(9.0));
    serving->set(kRKCellMonitorBandInfo, Value::real(9.5));
    serving->set(kRKCellMonitorUARFCN, Value::integer(-5));
    deliverPropertyList(0xFF0001, List::make({serving}));
    EXPECT_EQ(display(), "{\"Physical Cell ID\": \"9\", \"UARFCN\": \"-5\"}");
}

TEST_F(LTEServingCellInfoTest, EntriesThatAreNoCellsAreSkipped)
{
    auto typeless = cell(4);
    typeless->remove(kRKCellMonitorCellType);
    deliverPropertyList(0xFF0001, List::make({"text", Value::integer(1), List::make(), typeless, cell(5)}));
    EXPECT_EQ(shown("Cell Identity"), "\"5\"");
}

TEST_F(LTEServingCellInfoTest, PayloadThatIsNoListHasNoCells)
{
    deliverPropertyList(0xFF0001, cell(5));
    deliverPropertyList(0xFF0001, List::make());
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + Trace);
}

TEST_F(LTEServingCellInfoTest, PayloadThatDoesNotParseIsLoggedTwice)
{
    const Bytes garbage {'g', 'a', 'r'};
    deliver(0xFF0001, RecordBuilder::withPayload(0xFF0001, garbage));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(),
        std::string(Trace) + "<3>Cell Info Array data could not be constructed\n<3>Failed to get Cell Array\n\n");
}

TEST_F(LTEServingCellInfoTest, ServingCellAfterCellInformationShowsTheRawDownlinkChannel)
{
    deliverPropertyList(0xFF0001, List::make({cell(5)}));
    deliver(0xB0C2, servingCell());
    EXPECT_EQ(shown("UARFCN"), "none");
    EXPECT_EQ(shown("Download Frequency"), "\"1300\"");
}

} // namespace
} // namespace spectrel
