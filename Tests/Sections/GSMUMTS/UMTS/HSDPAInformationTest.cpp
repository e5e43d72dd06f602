#include "Sections/GSMUMTS/UMTS/HSDPAInformation.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class HSDPAInformationTest : public SectionFixture<HSDPAInformation> {
protected:
    HSDPAInformationTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>HSDPA Info\n";

TEST_F(HSDPAInformationTest, SubscribesToItsCode)
{
    EXPECT_EQ(section.getSectionName(), "HSDPA Info");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x4221}));
}

TEST_F(HSDPAInformationTest, RecordOf17BytesChangesNothingAndOneOf18SetsTheScalarKeysInOrder)
{
    deliver(0x4221, RecordBuilder(0x4221, 17).u8(13, 2));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
    deliver(0x4221, RecordBuilder(0x4221, 18).u8(13, 2).u8(14, 100));
    EXPECT_EQ(display(), "{\"Version\": \"2\", \"Sub Frames\": \"100\", \"Carrier Info\": \"Single Carrier\"}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(HSDPAInformationTest, CarriersAreNamedByTwoBits)
{
    const std::pair<std::uint32_t, const char*> carriers[] = {{0x00, "Single Carrier"}, {0x04, "MIMO"},
        {0x08, "Dual Carrier"}, {0x0C, "Reserved"}, {0xF3, "Single Carrier"}, {0xFF, "Reserved"}};
    for (const auto& [byte, name] : carriers) {
        deliver(0x4221, RecordBuilder(0x4221, 18).u8(15, byte));
        EXPECT_EQ(shown("Carrier Info"), "\"" + std::string(name) + "\"") << byte;
    }
}

TEST_F(HSDPAInformationTest, SubFramesHaveTenBits)
{
    deliver(0x4221, RecordBuilder(0x4221, 18).u8(14, 0xFF).u8(15, 0x03));
    EXPECT_EQ(shown("Sub Frames"), "\"1023\"");
    deliver(0x4221, RecordBuilder(0x4221, 18).u8(14, 0x00).u8(15, 0xFD));
    EXPECT_EQ(shown("Sub Frames"), "\"256\"");
}

TEST_F(HSDPAInformationTest, SecondaryProcessesStandFarBehindThePrimary)
{
    RecordBuilder record(0x4221, 18 + 162 + 9);
    record.u8(16, 1).u8(17, 1);
    record.u8(18, 5).u32(19, 1000).u16(23, 20).u16(25, 3);
    record.u8(27, 99); // directly behind: not read
    record.u8(180, 6).u32(181, 2000).u16(185, 40).u16(187, 65535);
    deliver(0x4221, record);
    EXPECT_EQ(shown("Primary HARQ Process"),
        "[{\"Process ID\": \"5\", \"No Rx Bits\": \"1000\", \"New Tx\": \"20\", \"Block Errors\": \"3\"}]");
    EXPECT_EQ(shown("Secondary HARQ Process"),
        "[{\"Process ID\": \"6\", \"No Rx Bits\": \"2000\", \"New Tx\": \"40\", \"Block Errors\": \"65535\"}]");
}

TEST_F(HSDPAInformationTest, ProcessesFollowEachOther)
{
    RecordBuilder record(0x4221, 18 + 2 * 162 + 2 * 9);
    record.u8(16, 2).u8(17, 2).u8(18, 1).u8(27, 2).u8(342, 3).u8(351, 4);
    deliver(0x4221, record);
    EXPECT_EQ(shown("Primary HARQ Process"),
        "[{\"Process ID\": \"1\", \"No Rx Bits\": \"0\", \"New Tx\": \"0\", \"Block Errors\": \"0\"}, "
        "{\"Process ID\": \"2\", \"No Rx Bits\": \"0\", \"New Tx\": \"0\", \"Block Errors\": \"0\"}]");
    EXPECT_EQ(shown("Secondary HARQ Process"),
        "[{\"Process ID\": \"3\", \"No Rx Bits\": \"0\", \"New Tx\": \"0\", \"Block Errors\": \"0\"}, "
        "{\"Process ID\": \"4\", \"No Rx Bits\": \"0\", \"New Tx\": \"0\", \"Block Errors\": \"0\"}]");
}

TEST_F(HSDPAInformationTest, SecondaryProcessesAloneStandAtTheStart)
{
    deliver(0x4221, RecordBuilder(0x4221, 27).u8(17, 1).u8(18, 7));
    EXPECT_EQ(shown("Primary HARQ Process"), "none");
    EXPECT_EQ(shown("Secondary HARQ Process"),
        "[{\"Process ID\": \"7\", \"No Rx Bits\": \"0\", \"New Tx\": \"0\", \"Block Errors\": \"0\"}]");
}

TEST_F(HSDPAInformationTest, RecordWithoutProcessesLeavesTheirLists)
{
    deliver(0x4221, RecordBuilder(0x4221, 400).u8(16, 2).u8(17, 1).u8(18, 1).u8(27, 2).u8(342, 3));
    const std::string primary = shown("Primary HARQ Process");
    const std::string secondary = shown("Secondary HARQ Process");
    EXPECT_NE(primary.find("\"Process ID\": \"2\""), std::string::npos);
    EXPECT_NE(secondary.find("\"Process ID\": \"3\""), std::string::npos);
    deliver(0x4221, RecordBuilder(0x4221, 400));
    EXPECT_EQ(shown("Primary HARQ Process"), primary);
    EXPECT_EQ(shown("Secondary HARQ Process"), secondary);
}

TEST_F(HSDPAInformationTest, NumbersAreUnsigned)
{
    deliver(0x4221,
        RecordBuilder(0x4221, 27).u8(13, 255).u8(16, 1).u8(18, 254).u32(19, 0xFFFFFFFF).u16(23, 65533).u16(25, 65532));
    EXPECT_EQ(shown("Version"), "\"255\"");
    EXPECT_EQ(shown("Primary HARQ Process"),
        "[{\"Process ID\": \"254\", \"No Rx Bits\": \"4294967295\", \"New Tx\": \"65533\", "
        "\"Block Errors\": \"65532\"}]");
}

TEST_F(HSDPAInformationTest, ProcessesPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x4221, RecordBuilder(0x4221, 18).u8(16, 255).u8(17, 255));
    const char* zeros = "{\"Process ID\": \"0\", \"No Rx Bits\": \"0\", \"New Tx\": \"0\", \"Block Errors\": \"0\"}";
    EXPECT_EQ(countOf(zeros, shown("Primary HARQ Process")), 255u);
    EXPECT_EQ(countOf(zeros, shown("Secondary HARQ Process")), 255u);
}

TEST_F(HSDPAInformationTest, OtherCodeIsIgnoredWithoutAMessage)
{
    deliver(0x4222, RecordBuilder(0x4222, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

} // namespace
} // namespace spectrel
