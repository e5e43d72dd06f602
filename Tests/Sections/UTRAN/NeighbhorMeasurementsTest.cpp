// The two lists of neighbours: UTRAN cells (0xD00A) and GSM cells (0xD00E).

#include "Sections/UTRAN/NeighbhorMeasurements.h"
#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xD00A;
constexpr std::uint32_t GSMCode = 0xD00E;
constexpr const char* Trace = "<4>NeighbhorMeasurements List\n";
constexpr const char* GSMTrace = "<4>GSM Neighbor Cell List\n";

class UTRANNeighbhorMeasurementsTest : public SectionFixture<UTRANNeighbhorMeasurements> {
protected:
    UTRANNeighbhorMeasurementsTest()
        : SectionFixture(List::make())
    {
    }
    /// Entries from offset 168 on, 16 bytes each.
    static RecordBuilder record(std::uint32_t count)
    {
        return RecordBuilder(Code, 168 + 16 * count).u8(16, count << 1);
    }
};

class GSMNeighbhorMeasurementsTest : public SectionFixture<GSMNeighbhorMeasurements> {
protected:
    GSMNeighbhorMeasurementsTest()
        : SectionFixture(List::make())
    {
    }
    /// Entries from offset 17 on, 8 bytes each.
    static RecordBuilder record(std::uint32_t count)
    {
        return RecordBuilder(GSMCode, 17 + 8 * count).u8(16, count);
    }
};

TEST_F(UTRANNeighbhorMeasurementsTest, CountIsInTheUpperSevenBitsAndEntriesStandAt168And184)
{
    deliver(Code, record(2).u8(16, 0x05).u16(168, 10054).u16(184, 10062));
    EXPECT_EQ(display(),
        "[{\"UARFCN\": \"10054\", \"Cell ID\": \"0\", \"Filter RSCP\": \"0.000000\", \"Status\": \"ASET\", "
        "\"inJDCS\": \"FALSE\"}, "
        "{\"UARFCN\": \"10062\", \"Cell ID\": \"0\", \"Filter RSCP\": \"0.000000\", \"Status\": \"ASET\", "
        "\"inJDCS\": \"FALSE\"}]");
    EXPECT_EQ(log(), Trace);
}

TEST_F(UTRANNeighbhorMeasurementsTest, EveryBitOfTheSecondEntryShowsInItsOwnField)
{
    const char* const statuses[] {"ASET", "MSET", "DSET", ""};
    const BitSweep sweep(
        {
            {"UARFCN", 184, 0, 14, plain},
            {"Cell ID", 185, 6, 7, plain},
            {"Filter RSCP", 186, 5, 8, [](unsigned raw) { return printed("%f", raw * 0.00390625); }},
            {"Status", 187, 5, 2, [&](unsigned raw) { return std::string(statuses[raw]); }},
            {"inJDCS", 187, 7, 1, [](unsigned raw) { return std::string(raw ? "TRUE" : "FALSE"); }},
        },
        [this](const Bytes& swept) {
            deliver(Code, swept);
            return shownEntry(1);
        });
    sweep.run(record(2).bytes(), 168, 200);
}

TEST_F(UTRANNeighbhorMeasurementsTest, EveryBitOfTheCountCountsAndNoOther)
{
    for (unsigned bit = 0; bit < 8; ++bit) {
        deliver(Code, record(0).u8(16, 1u << bit));
        EXPECT_EQ(shownCount(), bit == 0 ? 0u : 1u << (bit - 1)) << bit;
    }
    deliver(Code, record(0).u8(16, 0xFF));
    EXPECT_EQ(shownCount(), 127u);
}

TEST_F(UTRANNeighbhorMeasurementsTest, FourthStatusHasNoKey)
{
    deliver(Code, record(1).u8(171, 0x60));
    EXPECT_EQ(shownEntry(0).find("Status"), std::string::npos);
    deliver(Code, record(1).u8(171, 0x80));
    EXPECT_NE(shownEntry(0).find("\"Status\": \"ASET\", \"inJDCS\": \"TRUE\""), std::string::npos);
}

TEST_F(UTRANNeighbhorMeasurementsTest, FilterRSCPHasSixDecimalsAndTiesToEven)
{
    // Bits 5 to 7 of the entry's third byte, bits 0 to 4 of its fourth.
    const std::pair<std::uint32_t, const char*> levels[] {
        {128, "0.500000"}, {1, "0.003906"}, {2, "0.007812"}, {6, "0.023438"}, {255, "0.996094"}};
    for (const auto& [raw, text] : levels) {
        deliver(Code, record(1).u16(170, raw << 5));
        EXPECT_NE(shownEntry(0).find("\"Filter RSCP\": \"" + std::string(text) + "\""), std::string::npos) << raw;
    }
}

TEST_F(UTRANNeighbhorMeasurementsTest, RecordOf21BytesReadsItsEntriesAsZeros)
{
    deliver(Code, record(3).shrink(21));
    EXPECT_EQ(shownCount(), 3u);
    EXPECT_EQ(shownEntry(2),
        "{\"UARFCN\": \"0\", \"Cell ID\": \"0\", \"Filter RSCP\": \"0.000000\", \"Status\": \"ASET\", "
        "\"inJDCS\": \"FALSE\"}");
}

TEST_F(UTRANNeighbhorMeasurementsTest, RecordOf20BytesKeepsTheList)
{
    deliver(Code, record(2));
    log();
    deliver(Code, record(0).shrink(20));
    EXPECT_EQ(shownCount(), 2u);
    EXPECT_EQ(log(), Trace);
}

TEST_F(UTRANNeighbhorMeasurementsTest, CountOfZeroEmptiesTheList)
{
    deliver(Code, record(2));
    deliver(Code, record(0));
    EXPECT_EQ(display(), "[]");
}

TEST_F(UTRANNeighbhorMeasurementsTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(Code, record(2));
    log();
    deliver(GSMCode, record(0));
    EXPECT_EQ(shownCount(), 2u);
    EXPECT_EQ(log(), Trace);
}

TEST_F(GSMNeighbhorMeasurementsTest, EveryBitOfTheSecondEntryShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Cell ID", 25, 0, 14, plain},
            {"Band Indicator", 26, 6, 1, plain},
            {"BSIC Valid", 26, 7, 1, plain},
            {"NCC", 27, 0, 8, plain},
            {"BCC", 28, 0, 8, plain},
            {"ARFCN", 29, 0, 16, plain},
            {"RSSI", 31, 0, 16, [](unsigned raw) { return printed("%d", raw < 32768 ? int(raw) : int(raw) - 65536); }},
        },
        [this](const Bytes& swept) {
            deliver(GSMCode, swept);
            return shownEntry(1);
        });
    sweep.run(record(2).bytes(), 17, 33);
}

TEST_F(GSMNeighbhorMeasurementsTest, RSSIIsSigned)
{
    deliver(GSMCode, record(1).u16(23, 0xFFFF));
    EXPECT_NE(shownEntry(0).find("\"RSSI\": \"-1\""), std::string::npos);
    EXPECT_EQ(log(), GSMTrace);
}

TEST_F(GSMNeighbhorMeasurementsTest, CountBeyondTheRecordReadsZeros)
{
    deliver(GSMCode, record(0).u8(16, 255));
    EXPECT_EQ(shownCount(), 255u);
    EXPECT_EQ(shownEntry(254),
        "{\"Cell ID\": \"0\", \"Band Indicator\": \"0\", \"BSIC Valid\": \"0\", \"NCC\": \"0\", \"BCC\": \"0\", "
        "\"ARFCN\": \"0\", \"RSSI\": \"0\"}");
}

TEST_F(GSMNeighbhorMeasurementsTest, RecordOf16BytesKeepsTheListAndOneOf17EmptiesIt)
{
    deliver(GSMCode, record(3));
    log();
    deliver(GSMCode, record(0).shrink(16));
    EXPECT_EQ(shownCount(), 3u);
    deliver(GSMCode, record(0));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log(), std::string(GSMTrace) + GSMTrace);
}

TEST_F(GSMNeighbhorMeasurementsTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(GSMCode, record(2));
    log();
    deliver(Code, record(0));
    EXPECT_EQ(shownCount(), 2u);
    EXPECT_EQ(log(), GSMTrace);
}

} // namespace
} // namespace spectrel
