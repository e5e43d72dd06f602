#include "Sections/LTE/ServingCellMeasurement.h"

#include "Tests/Sections/BitSweep.h"
#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

constexpr std::uint32_t Code = 0xB17F;
constexpr const char* Trace = "<4>Serving Cell Measurements\n";

std::string rsrp(unsigned raw)
{
    return printed("%4.2f dBm", raw * 0.25 - 140);
}

std::string rsrq(unsigned raw)
{
    return printed("%4.2f dB", raw * 0.25 - 30);
}

std::string power(unsigned raw)
{
    return raw == 64 ? "Not Present" : printed("%d dBm", static_cast<int>(raw) - 30);
}

class ServingCellMeasurementTest : public SectionFixture<ServingCellMeasurement> {
protected:
    ServingCellMeasurementTest()
        : SectionFixture(Dictionary::make())
    {
    }
    static RecordBuilder record()
    {
        return RecordBuilder(Code, 33);
    }
    std::string shownAfter(const RecordBuilder& record, std::string_view key)
    {
        deliver(Code, record);
        return shown(key);
    }
};

TEST_F(ServingCellMeasurementTest, EveryBitShowsInItsOwnField)
{
    const BitSweep sweep(
        {
            {"Version", 13, 0, 8, plain},
            {"E-ARFCN", 17, 0, 16, plain},
            {"Physical Cell ID", 19, 0, 9, plain},
            {"Serving Layer Priority", 20, 1, 4, plain},
            {"Measured RSRP", 21, 0, 9, rsrp},
            {"Average RSRP", 22, 1, 9, rsrp},
            {"Measured RSRQ", 23, 2, 7, rsrq},
            {"Average RSRQ", 24, 1, 7, rsrq},
            {"Measured RSSI", 25, 0, 9, [](unsigned raw) { return printed("%4.2f dBm", raw * 0.5 - 140); }},
            {"Qrxlevmin", 26, 1, 6, [](unsigned raw) { return printed("%d dBm", static_cast<int>(raw) * 2 - 140); }},
            {"P_Max", 26, 7, 7, power},
            {"Max UE Tx Power", 27, 6, 6, power},
            {"Srxlev", 29, 0, 7, [](unsigned raw) { return printed("%d dBm", static_cast<int>(raw) - 30); }},
            {"Num of Consecutive DRX Cycles of S < 0", 29, 7, 6, plain},
            {"S Intra Search", 30, 5, 6,
                [](unsigned raw) { return raw == 32 ? "Not Present" : printed("%d dB", static_cast<int>(raw) * 2); }},
            {"S Non Intra Search", 31, 3, 6,
                [](unsigned raw) { return raw == 32 ? "Not Present" : printed("%d dBm", static_cast<int>(raw) * 2); }},
            {"Measurement Rules Updated", 32, 1, 1, [](unsigned raw) { return std::string(raw ? "True" : "False"); }},
            {"Measurement Rules", 32, 2, 4, plain},
        },
        [this](const Bytes& swept) {
            deliver(Code, swept);
            return display();
        });
    sweep.run(RecordBuilder(Code, 36).bytes(), 13, 36);
    EXPECT_EQ(log().find("<3>"), std::string::npos);
}

TEST_F(ServingCellMeasurementTest, RecordOf32BytesIsIgnored)
{
    deliver(Code, record().shrink(32));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ServingCellMeasurementTest, RecordOf33BytesSets18Keys)
{
    deliver(Code, record());
    EXPECT_EQ(shown("Version"), "\"0\"");
    EXPECT_EQ(shown("Measurement Rules"), "\"0\"");
    EXPECT_EQ(log(), Trace);
}

TEST_F(ServingCellMeasurementTest, LargestPowerThatIsPresentIsOneBelowNotPresent)
{
    // P_Max: bit 7 of byte 26, bits 0 to 5 of byte 27.
    EXPECT_EQ(shownAfter(record().u8(27, 0x20), "P_Max"), "\"Not Present\"") << 64;
    EXPECT_EQ(shownAfter(record().u8(26, 0x80).u8(27, 0x1F), "P_Max"), "\"33 dBm\"") << 63;
    EXPECT_EQ(shownAfter(record().u8(26, 0x80).u8(27, 0x20), "P_Max"), "\"35 dBm\"") << 65;
}

TEST_F(ServingCellMeasurementTest, MaxTxPowerCanNeverBeNotPresent)
{
    // Bits 6 and 7 of byte 27, bits 0 to 3 of byte 28.
    for (std::uint32_t raw = 0; raw < 64; ++raw)
        EXPECT_NE(shownAfter(record().u16(27, raw << 6), "Max UE Tx Power"), "\"Not Present\"") << raw;
    EXPECT_EQ(shown("Max UE Tx Power"), "\"33 dBm\"");
}

TEST_F(ServingCellMeasurementTest, SearchThresholdsAreInTheirOwnUnits)
{
    // Intra: bits 5 to 7 of byte 30, bits 0 to 2 of byte 31. Non-intra: bits 3 to 7 of byte 31, bit 0 of byte 32.
    EXPECT_EQ(shownAfter(record().u16(30, 32 << 5), "S Intra Search"), "\"Not Present\"");
    EXPECT_EQ(shownAfter(record().u16(30, 5 << 5), "S Intra Search"), "\"10 dB\"");
    EXPECT_EQ(shownAfter(record().u16(31, 32 << 3), "S Non Intra Search"), "\"Not Present\"");
    EXPECT_EQ(shownAfter(record().u16(31, 5 << 3), "S Non Intra Search"), "\"10 dBm\"");
}

TEST_F(ServingCellMeasurementTest, QrxlevminCountsStepsOfTwo)
{
    EXPECT_EQ(shownAfter(record().u8(26, 22 << 1), "Qrxlevmin"), "\"-96 dBm\"");
}

TEST_F(ServingCellMeasurementTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0xB180, RecordBuilder(0xB180, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 45440\n");
}

} // namespace
} // namespace spectrel
