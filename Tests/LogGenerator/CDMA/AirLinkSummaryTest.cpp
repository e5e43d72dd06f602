#include "Tests/LogGenerator/CDMA/C2KFixture.h"

namespace spectrel {
namespace {

constexpr std::uint8_t Idle = 3;
constexpr std::uint8_t Access = 4;

class AirLinkSummaryTest : public C2KFixture {
protected:
    AirLinkSummaryTest()
        : C2KFixture({"kChannel", "k1xEVDODeviceState", "kBandClass", "kRxAGC0", "kRxAGC1", "kTxAGC",
            "kServingPNOffset", "kSessionState", "kUATI24", "kColorCode"})
    {
    }
    static RecordBuilder record(std::uint8_t deviceState = Access)
    {
        return RecordBuilder(0x1183, 50).u8(36, deviceState);
    }
};

TEST_F(AirLinkSummaryTest, EveryFieldIsShown)
{
    deliver(record(5)
                .u8(13, 0x2C)
                .u8(14, 1 << 3 | 3)
                .u8(15, 0xB0)
                .u8(16, 0xAF)
                .u8(17, 10)
                .u16(18, 16)
                .u8(37, 4)
                .u16(38, 0x3412)
                .u8(40, 0x0B)
                .u8(41, 200));
    EXPECT_EQ(display(),
        "{\"kChannel\": \"812\", \"k1xEVDODeviceState\": \"Connected [5]\", \"kBandClass\": "
        "\"1.8 to 2.0GHz PCS band [1]\", \"kRxAGC0\": \"-80 dBm\", \"kRxAGC1\": \"-81 dBm\", \"kTxAGC\": \"+10 dBm\", "
        "\"kServingPNOffset\": \"16 \u00D7 64chips\", \"kSessionState\": \"Open [4]\", \"kUATI24\": \"0x0b3412\", "
        "\"kColorCode\": \"200\"}");
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(AirLinkSummaryTest, OnlyFiftyBytesAreTaken)
{
    const std::string before = display();
    deliver(RecordBuilder(0x1183, 49).u8(13, 1));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x1183 is 49 bytes long but should be 50 bytes.\n");
    deliver(RecordBuilder(0x1183, 51).u8(13, 1));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x1183 is 51 bytes long but should be 50 bytes.\n");
    EXPECT_EQ(display(), before);
}

TEST_F(AirLinkSummaryTest, SecondReceiverAndTransmitterAreNotAvailableBelowAccess)
{
    deliver(record(Idle).u8(16, 1).u8(17, 2));
    EXPECT_EQ(shown("kRxAGC1"), "\"N/A\"");
    EXPECT_EQ(shown("kTxAGC"), "\"N/A\"");
    deliver(record(Access).u8(16, 1).u8(17, 2));
    EXPECT_EQ(shown("kRxAGC1"), "\"+1 dBm\"");
    EXPECT_EQ(shown("kTxAGC"), "\"+2 dBm\"");
}

TEST_F(AirLinkSummaryTest, PowersAreSignedWithAPlusAtZero)
{
    deliver(record().u8(15, 0).u8(16, 127).u8(17, 128));
    EXPECT_EQ(shown("kRxAGC0"), "\"+0 dBm\"");
    EXPECT_EQ(shown("kRxAGC1"), "\"+127 dBm\"");
    EXPECT_EQ(shown("kTxAGC"), "\"-128 dBm\"");
}

TEST_F(AirLinkSummaryTest, PilotOffsetOfAllOnesIsInvalid)
{
    deliver(record().u16(18, 0xFFFF));
    EXPECT_EQ(shown("kServingPNOffset"), "\"Invalid Value\"");
    deliver(record().u16(18, 0xFFFE));
    EXPECT_EQ(shown("kServingPNOffset"), "\"65534 \u00D7 64chips\"");
}

TEST_F(AirLinkSummaryTest, DeviceStatesHaveTheirTexts)
{
    const char* const texts[] = {"Inactive [0]", "Acquisition [1]", "Sync [2]", "Idle [3]", "Access [4]",
        "Connected [5]", "[Reserved 6]", "[Reserved 7]"};
    for (std::uint8_t value = 0; value < std::size(texts); ++value) {
        deliver(record(value));
        EXPECT_EQ(shown("k1xEVDODeviceState"), '"' + std::string(texts[value]) + '"');
    }
    deliver(record(255));
    EXPECT_EQ(shown("k1xEVDODeviceState"), "\"[Reserved 255]\"");
}

TEST_F(AirLinkSummaryTest, SessionStatesHaveTheirTexts)
{
    const char* const texts[] = {
        "Closed [0]", "AMP setup [1]", "AT-initiated neg [2]", "Initiated neg [3]", "Open [4]", "[Reserved 5]"};
    for (std::uint8_t value = 0; value < std::size(texts); ++value) {
        deliver(record().u8(37, value));
        EXPECT_EQ(shown("kSessionState"), '"' + std::string(texts[value]) + '"');
    }
}

TEST_F(AirLinkSummaryTest, BandClassesHaveTheirTexts)
{
    const char* const texts[] = {"800 MHz cellular band [0]", "1.8 to 2.0GHz PCS band [1]",
        "872 to 960MHz TACS band [2]", "832 to 925MHz JTACS band [3]", "1.75 to 1.87GHz Korean PCS band [4]",
        "450MHz band [5]", "2GHz band [6]", "700MHz band [7]", "1800 MHz band [8]", "900 MHzband [9]",
        "Secondary 800 MHz band [10]", "400 MHz European PAMR band [11]", "800 MHz European PAMR band [12]",
        "[Bad Value 13]"};
    for (std::uint8_t value = 0; value < std::size(texts); ++value) {
        deliver(record().u8(14, static_cast<std::uint32_t>(value << 3 | 7)));
        EXPECT_EQ(shown("kBandClass"), '"' + std::string(texts[value]) + '"');
    }
    deliver(record().u8(14, 0xFF));
    EXPECT_EQ(shown("kBandClass"), "\"[Bad Value 31]\"");
}

TEST_F(AirLinkSummaryTest, AddressHasAtLeastSixDigits)
{
    deliver(record());
    EXPECT_EQ(shown("kUATI24"), "\"0x000000\"");
    deliver(record().u16(38, 0xFFFF).u8(40, 0xFF).u8(41, 0xFF));
    EXPECT_EQ(shown("kUATI24"), "\"0xffffff\"");
}

} // namespace
} // namespace spectrel
