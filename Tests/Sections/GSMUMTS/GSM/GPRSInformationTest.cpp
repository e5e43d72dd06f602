#include "Sections/GSMUMTS/GSM/GPRSInformation.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class GPRSInformationTest : public SectionFixture<GPRSInformation> {
protected:
    GPRSInformationTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>GPRSInformation\n";

TEST_F(GPRSInformationTest, SubscribesToItsSevenCodes)
{
    EXPECT_EQ(section.getSectionName(), "GPRS Information");
    EXPECT_EQ(section.getLogCodeArray(),
        (std::vector<std::uint32_t> {0x51F5, 0x7135, 0x51F6, 0x51FB, 0x51FD, 0x51F4, 0x5137}));
}

TEST_F(GPRSInformationTest, NetworkControlIsShownInOrder)
{
    deliver(0x51F5, RecordBuilder(0x51F5, 18).u8(13, 255).u8(14, 0).u8(15, 2));
    EXPECT_EQ(display(),
        "{\"Network Control Order\": \"NC2\", \"PFC Supported\": \"Available\", "
        "\"Priority Access Threshold\": \"Barred (PKT access not allowed in the Cell)\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GPRSInformationTest, RecordsOneByteTooShortChangeNothing)
{
    const std::pair<std::uint32_t, std::size_t> minimumLengths[] = {
        {0x51F4, 15}, {0x51F5, 18}, {0x51F6, 24}, {0x51FB, 34}, {0x51FD, 35}, {0x5137, 29}, {0x7135, 32}};
    for (const auto& [code, length] : minimumLengths) {
        deliver(code, RecordBuilder(code, length - 1));
        EXPECT_EQ(display(), "{}") << code;
        EXPECT_EQ(log(), Trace) << code;
    }
    for (const auto& [code, length] : minimumLengths) {
        const std::string before = display();
        deliver(code, RecordBuilder(code, length));
        EXPECT_NE(display(), before) << code;
        EXPECT_EQ(log(), Trace) << code;
    }
}

TEST_F(GPRSInformationTest, EverySI13PositionHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x51F4, RecordBuilder(0x51F4, 15), 14, "SI13 Position"),
        textsForEachByte({"Located on BCCH", "Located on Extended BCCH"}, "Unknown", "Not Available"));
}

TEST_F(GPRSInformationTest, SI13Position255IsNotAvailableAndTwoIsUnknown)
{
    deliver(0x51F4, RecordBuilder(0x51F4, 15).u8(14, 255));
    EXPECT_EQ(display(), "{\"SI13 Position\": \"Not Available\"}");
    deliver(0x51F4, RecordBuilder(0x51F4, 15).u8(14, 2));
    EXPECT_EQ(display(), "{\"SI13 Position\": \"Unknown\"}");
}

TEST_F(GPRSInformationTest, EveryNetworkControlOrderHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x51F5, RecordBuilder(0x51F5, 18), 15, "Network Control Order"),
        textsForEachByte({"NC0", "NC1", "NC2"}, "Unknown", "Not Available"));
}

TEST_F(GPRSInformationTest, EveryPacketFlowContextHasItsNameAnd255IsAvailable)
{
    EXPECT_EQ(shownForEachByte(0x51F5, RecordBuilder(0x51F5, 18), 13, "PFC Supported"),
        textsForEachByte({"Not Supported", "Supported"}, "Unknown", "Available"));
}

TEST_F(GPRSInformationTest, EveryAccessThresholdHasItsName)
{
    EXPECT_EQ(shownForEachByte(0x51F5, RecordBuilder(0x51F5, 18), 14, "Priority Access Threshold"),
        textsForEachByte({"Barred (PKT access not allowed in the Cell)", "Barred", "Barred", "1 Only", "1 to 2",
                             "1 to 3", "1 to 4", "Allowed"},
            "Unknown", "Not Available"));
}

TEST_F(GPRSInformationTest, PacketCellOptionsAreShownInOrder)
{
    deliver(0x51F6, RecordBuilder(0x51F6, 24).u8(15, 9).u8(16, 4).u8(17, 0));
    EXPECT_EQ(display(), "{\"T3192\": \"?? ms\", \"Access Burst Type\": \"8-bit format\", \"DRX Timer Max\": \"4\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(GPRSInformationTest, EveryT3192HasItsTime)
{
    EXPECT_EQ(shownForEachByte(0x51F6, RecordBuilder(0x51F6, 24), 15, "T3192"),
        textsForEachByte({"500 ms", "1000 ms", "1500 ms", "0 ms", "80 ms", "120 ms", "160 ms", "200 ms"}, "?? ms"));
}

TEST_F(GPRSInformationTest, BurstsHave11BitsForAnythingButZero)
{
    EXPECT_EQ(shownForEachByte(0x51F6, RecordBuilder(0x51F6, 24), 17, "Access Burst Type"),
        textsForEachByte({"8-bit format"}, "11-bit format"));
}

TEST_F(GPRSInformationTest, PBCCHIsShownAsANumber)
{
    deliver(0x51FB, RecordBuilder(0x51FB, 34).u8(13, 255));
    EXPECT_EQ(display(), "{\"PBCCH Present\": \"255\"}");
}

TEST_F(GPRSInformationTest, PacketMeasurementIsShownInOrder)
{
    deliver(0x51FD, RecordBuilder(0x51FD, 35).u8(13, 1).u8(14, 2).u8(15, 3).u8(16, 4).u8(33, 5));
    EXPECT_EQ(display(),
        "{\"Ext Measurement Order\": \"4\", \"Packet PSI Status\": \"1\", \"Packet SI Status\": \"Supported\", "
        "\"Count LR\": \"2\", \"Count HR\": \"3\"}");
    EXPECT_EQ(shownForEachByte(0x51FD, RecordBuilder(0x51FD, 35), 33, "Packet SI Status"),
        textsForEachByte({"Not Supported"}, "Supported"));
}

TEST_F(GPRSInformationTest, HysteresisIsAppliedForAnythingButZero)
{
    EXPECT_EQ(shownForEachByte(0x5137, RecordBuilder(0x5137, 29), 26, "Cell Reselect Hysteresis"),
        textsForEachByte({"Not Applied"}, "Applied"));
    EXPECT_EQ(display(), "{\"Cell Reselect Hysteresis\": \"Applied\"}");
}

TEST_F(GPRSInformationTest, OperatingModeOneIsClass2AndThreeIsUnknown)
{
    deliver(0x7135, RecordBuilder(0x7135, 32).u8(13, 1));
    EXPECT_EQ(display(), "{\"Network Operating Mode\": \"Class 2\"}");
    EXPECT_EQ(shownForEachByte(0x7135, RecordBuilder(0x7135, 32), 13, "Network Operating Mode"),
        textsForEachByte({"Class 1", "Class 2", "Class 3"}, "Unknown"));
}

TEST_F(GPRSInformationTest, BytesAreUnsigned)
{
    deliver(0x51F6, RecordBuilder(0x51F6, 24).u8(16, 250));
    deliver(0x51FD, RecordBuilder(0x51FD, 35).u8(13, 251).u8(14, 252).u8(15, 253).u8(16, 254));
    EXPECT_EQ(shown("DRX Timer Max"), "\"250\"");
    EXPECT_EQ(shown("Packet PSI Status"), "\"251\"");
    EXPECT_EQ(shown("Count LR"), "\"252\"");
    EXPECT_EQ(shown("Count HR"), "\"253\"");
    EXPECT_EQ(shown("Ext Measurement Order"), "\"254\"");
}

TEST_F(GPRSInformationTest, ItsNeighbourCodesAreLoggedAsUnknown)
{
    for (const std::uint32_t code : {0x51F7u, 0x51F8u, 0x51F9u, 0x51FAu, 0x51FCu, 0x4005u}) {
        deliver(code, RecordBuilder(code, 60));
        EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: " + std::to_string(code) + "\n");
    }
    EXPECT_EQ(display(), "{}");
}

} // namespace
} // namespace spectrel
