// The two sections of the idle-mode neighbour measurement, code 0xB180.

#include "Sections/LTE/IdleNeighbour.h"
#include "LogGenerator/Template/ArrayOutOfBoundsException.h"
#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"
#include "Values/List.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xB180;

std::string halves(unsigned raw)
{
    return printed("%4.2f dBm", raw * 0.5 - 140);
}

std::string quarters(unsigned raw)
{
    return printed("%4.2f dB", raw * 0.25 - 30);
}

std::string srxlev(unsigned raw)
{
    return printed("%d dBm", static_cast<int>(raw) - 30);
}

class NeighborMeasurementMiscTest : public SectionFixture<NeighborMeasurementMisc> {
protected:
    NeighborMeasurementMiscTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

class NeighborCellsListTest : public SectionFixture<NeighborCellsList> {
protected:
    NeighborCellsListTest()
        : SectionFixture(List::make())
    {
    }
    /// `last`: index of the last entry.
    static RecordBuilder record(std::uint32_t last)
    {
        return RecordBuilder(Code, 21 + 20 * (last + 1)).u16(19, last << 6);
    }
};

constexpr const char* MiscTrace = "<4>Neighbor Measurements\n";
constexpr const char* ListTrace = "<4>Neighbor Cells List\n";
constexpr const char* EmptyEntryLines = "<4>Physical Cell ID: 0\n\n"
                                        "<4>Measured RSSI: -140.000000\n\n"
                                        "<4>Measured RSSI: -140.000000\n\n"
                                        "<4>Measured RSSI: -140.000000\n\n"
                                        "<4>Measured RSSI: -30.000000\n\n"
                                        "<4>Measured RSSI: -30.000000\n\n";

TEST_F(NeighborMeasurementMiscTest, EveryBitShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Version", 13, 0, 8, plain},
            {"E-ARFCN", 17, 0, 16, plain},
            {"Qrxlevmin", 19, 0, 6, [](unsigned raw) { return printed("%d dBm", static_cast<int>(raw) * 2 - 140); }},
        },
        [this](const Bytes& record) {
            deliver(Code, record);
            return display();
        });
    sweep.run(RecordBuilder(Code, 24).bytes(), 13, 24);
}

TEST_F(NeighborMeasurementMiscTest, QrxlevminCountsStepsOfTwo)
{
    deliver(Code, RecordBuilder(Code, 21).u8(19, 22));
    EXPECT_EQ(shown("Qrxlevmin"), "\"-96 dBm\"");
    EXPECT_EQ(log(), MiscTrace);
}

TEST_F(NeighborMeasurementMiscTest, RecordOf20BytesIsIgnored)
{
    deliver(Code, RecordBuilder(Code, 20));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), MiscTrace);
}

TEST_F(NeighborMeasurementMiscTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0xB17F, RecordBuilder(0xB17F, 60));
    EXPECT_EQ(log(), std::string(MiscTrace) + "<3>Received an unknown log message: 45439\n");
}

TEST_F(NeighborCellsListTest, CountFieldOfZeroStillMeansOneEntryAtOffset21)
{
    deliver(Code, RecordBuilder(Code, 41).u16(21, 300));
    EXPECT_EQ(display().find("[{\"Physical Cell ID\": \"300\", "), 0u) << display();
    EXPECT_EQ(display().find("}, {"), std::string::npos);
}

TEST_F(NeighborCellsListTest, EveryBitOfTheThirdEntryShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Physical Cell ID", 61, 0, 9, plain},
            {"Measured RSSI", 62, 1, 8, halves},
            {"Measured RSRP", 63, 1, 9, halves},
            {"Average RSRP", 65, 0, 9, halves},
            {"Measured RSRQ", 66, 1, 7, quarters},
            {"Average RSRQ", 67, 0, 7, quarters},
            {"Srxlev", 67, 7, 7, srxlev},
            {"Frequency Offset", 69, 0, 16, plain},
            {"Ant 0 Frame Offset", 73, 0, 11, plain},
            {"Ant 0 Sample Offset", 74, 3, 19, plain},
            {"Ant 1 Frame Offset", 73, 0, 11, plain},
            {"Ant 1 Sample Offset", 74, 3, 19, plain},
        },
        [this](const Bytes& swept) {
            deliver(Code, swept);
            return shownEntry(2);
        });
    sweep.run(record(2).bytes(), 21, 81);
}

TEST_F(NeighborCellsListTest, EveryBitOfTheCountCountsAndNoOther)
{
    for (unsigned bit = 0; bit < 16; ++bit) {
        deliver(Code, RecordBuilder(Code, 41).u16(19, 1u << bit));
        const std::size_t entries = bit >= 6 && bit <= 10 ? (1u << (bit - 6)) + 1 : 1;
        EXPECT_EQ(shownCount(), entries) << bit;
    }
    deliver(Code, RecordBuilder(Code, 41).u16(19, 0xFFFF));
    EXPECT_EQ(shownCount(), 32u);
}

TEST_F(NeighborCellsListTest, RSSIRunsAcrossItsBytes)
{
    deliver(Code, record(0).u8(22, 0x02).u8(23, 0x00));
    EXPECT_NE(display().find("\"Measured RSSI\": \"-139.50 dBm\""), std::string::npos) << display();
}

TEST_F(NeighborCellsListTest, SecondAntennaRepeatsTheFirst)
{
    deliver(Code, record(0).u32(33, 0x00012345));
    EXPECT_NE(display().find("\"Ant 0 Frame Offset\": \"837\", \"Ant 0 Sample Offset\": \"36\", "
                             "\"Ant 1 Frame Offset\": \"837\", \"Ant 1 Sample Offset\": \"36\""),
        std::string::npos)
        << display();
}

TEST_F(NeighborCellsListTest, LinesComeInOrderWithOneLabelForAllLevels)
{
    // PCI 5; RSSI 100, RSRP 91 and 93 in halves of a dBm; RSRQ 75 and 77 in quarters of a dB.
    deliver(Code, record(1).u16(21, 5).u8(22, 100 << 1).u16(23, 91 << 1).u16(25, 93 | 75 << 9).u8(27, 77));
    EXPECT_EQ(log(),
        std::string(ListTrace)
            + "<4>Number of neighboring cells being reported: 2\n\n"
              "<4>Physical Cell ID: 5\n\n"
              "<4>Measured RSSI: -90.000000\n\n"
              "<4>Measured RSSI: -94.500000\n\n"
              "<4>Measured RSSI: -93.500000\n\n"
              "<4>Measured RSSI: -11.250000\n\n"
              "<4>Measured RSSI: -10.750000\n\n"
            + EmptyEntryLines);
}

TEST_F(NeighborCellsListTest, RecordOf21BytesReadsItsOneEntryAsZeros)
{
    deliver(Code, RecordBuilder(Code, 21));
    EXPECT_EQ(shownCount(), 1u);
    EXPECT_EQ(log(), std::string(ListTrace) + "<4>Number of neighboring cells being reported: 1\n\n" + EmptyEntryLines);
}

TEST_F(NeighborCellsListTest, RecordOf20BytesKeepsTheList)
{
    deliver(Code, record(3));
    log();
    deliver(Code, RecordBuilder(Code, 20));
    EXPECT_EQ(shownCount(), 4u);
    EXPECT_EQ(log(), ListTrace);
}

TEST_F(NeighborCellsListTest, EveryRecordRebuildsTheList)
{
    deliver(Code, record(31));
    EXPECT_EQ(shownCount(), 32u);
    deliver(Code, record(0));
    EXPECT_EQ(shownCount(), 1u);
}

TEST_F(NeighborCellsListTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0xB186, RecordBuilder(0xB186, 60));
    EXPECT_EQ(log(), std::string(ListTrace) + "<3>Received an unknown log message: 45446\n");
}

TEST(IdleNeighbourRecordTest, IndexAboveTheLastIsRaised)
{
    const RecordBuilder bytes = RecordBuilder(Code, 21).u16(19, 1 << 6);
    const RepeatedGroup neighbours = IdleNeighbourRecord::neighbours(ByteView(bytes));
    EXPECT_EQ(neighbours.entry(1), 41u);
    EXPECT_THROW(neighbours.entry(2), ArrayOutOfBoundsException);
}

} // namespace
} // namespace spectrel
