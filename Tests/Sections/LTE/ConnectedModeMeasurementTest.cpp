// The three sections of the connected-mode measurement, code 0xB179.

#include "Sections/LTE/ConnectedModeMeasurement.h"
#include "LogGenerator/Template/ArrayOutOfBoundsException.h"
#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"
#include "Values/List.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xB179;

std::string filteredRSRP(unsigned raw)
{
    return printed("%4.2f dBm", raw * 0.25 - 140);
}

std::string filteredRSRQ(unsigned raw)
{
    return printed("%4.2f dB", raw * 0.125 - 20);
}

class ConnectedModeMeasurementMiscTest : public SectionFixture<ConnectedModeMeasurementMisc> {
protected:
    ConnectedModeMeasurementMiscTest()
        : SectionFixture(Dictionary::make())
    {
    }
    std::string shownRSRP(std::uint32_t raw)
    {
        deliver(Code, RecordBuilder(Code, 29).u16(23, raw));
        return shown("Serving Filtered RSRP");
    }
    std::string shownRSRQ(std::uint32_t raw)
    {
        deliver(Code, RecordBuilder(Code, 29).u16(25, raw));
        return shown("Serving Filtered RSRQ");
    }
};

class MeasuredNeighborCellsTest : public SectionFixture<MeasuredNeighborCells> {
protected:
    MeasuredNeighborCellsTest()
        : SectionFixture(List::make())
    {
    }
};

class DetectedCellsTest : public SectionFixture<DetectedCells> {
protected:
    DetectedCellsTest()
        : SectionFixture(List::make())
    {
    }
};

/// Two measured neighbours at 29 and 35, one detected cell at 41.
RecordBuilder twoMeasuredOneDetected()
{
    return RecordBuilder(Code, 43)
        .u8(27, 2)
        .u8(28, 1)
        .u16(29, 101)
        .u16(31, 200)
        .u16(33, 80)
        .u16(35, 102)
        .u16(37, 201)
        .u16(39, 81)
        .u16(41, 103);
}

constexpr const char* MiscTrace = "<4>Connected mode LTE Intra-frequency Measurement\n";
constexpr const char* MeasuredTrace = "<4>Measured Neighbor Cells\n";
constexpr const char* DetectedTrace = "<4>Detected Cells\n";

TEST_F(ConnectedModeMeasurementMiscTest, RecordOf29BytesSetsTheFiveKeysInOrder)
{
    deliver(Code, RecordBuilder(Code, 29).u16(17, 1300).u16(19, 503).u16(21, 9).u16(23, 180).u16(25, 72));
    EXPECT_EQ(display(),
        "{\"E-ARFCN\": \"1300\", \"Serving Physical Cell ID\": \"503\", \"Subframe Number\": \"9\", "
        "\"Serving Filtered RSRP\": \"-95.00 dBm\", \"Serving Filtered RSRQ\": \"-11.00 dB\"}");
    EXPECT_EQ(log(), MiscTrace);
}

TEST_F(ConnectedModeMeasurementMiscTest, RecordOf28BytesChangesNothing)
{
    deliver(Code, RecordBuilder(Code, 28));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), MiscTrace);
}

TEST_F(ConnectedModeMeasurementMiscTest, LevelsCountFromTheirLowest)
{
    EXPECT_EQ(shownRSRP(0), "\"-140.00 dBm\"");
    EXPECT_EQ(shownRSRP(560), "\"0.00 dBm\"");
    EXPECT_EQ(shownRSRP(0xFFFF), "\"16243.75 dBm\"");
    EXPECT_EQ(shownRSRQ(0), "\"-20.00 dB\"");
    EXPECT_EQ(shownRSRQ(160), "\"0.00 dB\"");
}

TEST_F(ConnectedModeMeasurementMiscTest, DecimalTiesRoundToEvenAsCPrintsThem)
{
    EXPECT_EQ(shownRSRQ(1), "\"-19.88 dB\"") << "of -19.875";
    EXPECT_EQ(shownRSRQ(3), "\"-19.62 dB\"") << "of -19.625";
    EXPECT_EQ(shownRSRQ(161), "\"0.12 dB\"") << "of 0.125";
    EXPECT_EQ(shownRSRQ(159), "\"-0.12 dB\"") << "of -0.125";
    EXPECT_EQ(shownRSRQ(163), "\"0.38 dB\"") << "of 0.375";
}

TEST_F(ConnectedModeMeasurementMiscTest, EveryBitShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"E-ARFCN", 17, 0, 16, plain},
            {"Serving Physical Cell ID", 19, 0, 16, plain},
            {"Subframe Number", 21, 0, 16, plain},
            {"Serving Filtered RSRP", 23, 0, 16, filteredRSRP},
            {"Serving Filtered RSRQ", 25, 0, 16, filteredRSRQ},
        },
        [this](const Bytes& record) {
            deliver(Code, record);
            return display();
        });
    sweep.run(RecordBuilder(Code, 40).bytes(), 13, 40);
}

TEST_F(ConnectedModeMeasurementMiscTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0xB17A, RecordBuilder(0xB17A, 40));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(MiscTrace) + "<3>Received an unknown log message: 45434\n");
}

TEST_F(MeasuredNeighborCellsTest, TwoEntriesComeFromOffsets29And35)
{
    deliver(Code, twoMeasuredOneDetected());
    EXPECT_EQ(display(),
        "[{\"Physical Cell ID\": \"101\", \"Filtered RSRP\": \"-90.00 dBm\", \"Filtered RSRQ\": \"-10.00 dB\"}, "
        "{\"Physical Cell ID\": \"102\", \"Filtered RSRP\": \"-89.75 dBm\", \"Filtered RSRQ\": \"-9.88 dB\"}]");
    EXPECT_EQ(log(), MeasuredTrace);
}

TEST_F(MeasuredNeighborCellsTest, NoneMeasuredEmptiesTheList)
{
    deliver(Code, twoMeasuredOneDetected());
    deliver(Code, RecordBuilder(Code, 29));
    EXPECT_EQ(display(), "[]");
}

TEST_F(MeasuredNeighborCellsTest, RecordOf28BytesKeepsTheList)
{
    deliver(Code, twoMeasuredOneDetected());
    const std::string before = display();
    log();
    deliver(Code, twoMeasuredOneDetected().shrink(28));
    EXPECT_EQ(display(), before);
    EXPECT_EQ(log(), MeasuredTrace);
}

TEST_F(MeasuredNeighborCellsTest, EveryBitOfTheCountCountsAndNoOther)
{
    for (unsigned bit = 0; bit < 24; ++bit) { // bytes 26 to 28
        deliver(Code, RecordBuilder(Code, 29).u8(26 + bit / 8, 1u << bit % 8));
        EXPECT_EQ(shownCount(), bit >= 8 && bit < 16 ? 1u << (bit - 8) : 0u) << bit;
    }
}

TEST_F(MeasuredNeighborCellsTest, CountBeyondTheRecordReadsZeros)
{
    deliver(Code, RecordBuilder(Code, 31).u8(27, 255).u16(29, 7));
    EXPECT_EQ(shownCount(), 255u);
    EXPECT_EQ(shownEntry(0),
        "{\"Physical Cell ID\": \"7\", \"Filtered RSRP\": \"-140.00 dBm\", \"Filtered RSRQ\": \"-20.00 dB\"}");
    EXPECT_EQ(shownEntry(254),
        "{\"Physical Cell ID\": \"0\", \"Filtered RSRP\": \"-140.00 dBm\", \"Filtered RSRQ\": \"-20.00 dB\"}");
}

TEST_F(MeasuredNeighborCellsTest, EveryBitOfTheSecondEntryShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Physical Cell ID", 35, 0, 16, plain},
            {"Filtered RSRP", 37, 0, 16, filteredRSRP},
            {"Filtered RSRQ", 39, 0, 16, filteredRSRQ},
        },
        [this](const Bytes& record) {
            deliver(Code, record);
            return shownEntry(1);
        });
    sweep.run(RecordBuilder(Code, 44).u8(27, 2).bytes(), 28, 44);
}

TEST_F(MeasuredNeighborCellsTest, OtherCodeKeepsTheListAndIsLoggedAsUnknown)
{
    deliver(Code, twoMeasuredOneDetected());
    const std::string before = display();
    log();
    deliver(0xB180, RecordBuilder(0xB180, 60));
    EXPECT_EQ(display(), before);
    EXPECT_EQ(log(), std::string(MeasuredTrace) + "<3>Received an unknown log message: 45440\n");
}

TEST_F(DetectedCellsTest, EntryFollowsTheMeasuredOnesAtOffset41)
{
    deliver(Code, twoMeasuredOneDetected());
    EXPECT_EQ(display(), "[{\"Physical Cell ID\": \"103\"}]");
    EXPECT_EQ(log(), DetectedTrace);
}

TEST_F(DetectedCellsTest, NoneDetectedEmptiesTheListWhateverIsMeasured)
{
    deliver(Code, twoMeasuredOneDetected());
    deliver(Code, twoMeasuredOneDetected().u8(28, 0));
    EXPECT_EQ(display(), "[]");
}

TEST_F(DetectedCellsTest, EveryBitOfTheCountCountsAndNoOther)
{
    for (unsigned bit = 0; bit < 24; ++bit) { // bytes 27 to 29
        deliver(Code, RecordBuilder(Code, 30).u8(27 + bit / 8, 1u << bit % 8));
        EXPECT_EQ(shownCount(), bit >= 8 && bit < 16 ? 1u << (bit - 8) : 0u) << bit;
    }
    deliver(Code, RecordBuilder(Code, 29).u8(28, 255));
    EXPECT_EQ(shownCount(), 255u);
}

TEST_F(DetectedCellsTest, RecordOf28BytesKeepsTheList)
{
    deliver(Code, twoMeasuredOneDetected());
    deliver(Code, twoMeasuredOneDetected().shrink(28));
    EXPECT_EQ(display(), "[{\"Physical Cell ID\": \"103\"}]");
}

TEST_F(DetectedCellsTest, MeasuredCountThatMovesThemBeyondTheRecordReadsZeros)
{
    deliver(Code, twoMeasuredOneDetected().u8(27, 255).u8(28, 2));
    EXPECT_EQ(display(), "[{\"Physical Cell ID\": \"0\"}, {\"Physical Cell ID\": \"0\"}]");
}

TEST_F(DetectedCellsTest, EveryBitOfTheSecondEntryShowsInItsOwnField)
{
    const BitSweep sweep({{"Physical Cell ID", 37, 0, 16, plain}}, [this](const Bytes& record) {
        deliver(Code, record);
        return shownEntry(1);
    });
    sweep.run(RecordBuilder(Code, 42).u8(27, 1).u8(28, 2).bytes(), 29, 42);
}

TEST_F(DetectedCellsTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(1, RecordBuilder(1, 60));
    EXPECT_EQ(log(), std::string(DetectedTrace) + "<3>Received an unknown log message: 1\n");
}

TEST(ConnectedModeRecordTest, IndexNotBelowItsCountIsRaised)
{
    const RecordBuilder bytes = twoMeasuredOneDetected();
    const RepeatedGroup measured = ConnectedModeRecord::measuredNeighbours(ByteView(bytes));
    EXPECT_EQ(measured.entry(1), 35u);
    EXPECT_THROW(measured.entry(2), ArrayOutOfBoundsException);
    const RepeatedGroup detected = ConnectedModeRecord::detectedCells(ByteView(bytes));
    EXPECT_EQ(detected.entry(0), 41u);
    EXPECT_THROW(detected.entry(1), ArrayOutOfBoundsException);
}

} // namespace
} // namespace spectrel
