#include "Tests/LogGenerator/CDMA/C2KFixture.h"

namespace spectrel {
namespace {

class SystemInformationTest : public C2KFixture {
protected:
    SystemInformationTest()
        : C2KFixture({"k1xRoamingHome", "kSystemId", "kNetworkId", "kPacketZoneId", "kBaseId", "kProtocolRevision"})
    {
    }
    static RecordBuilder record(std::size_t size = 186)
    {
        return RecordBuilder(0x134F, size).u8(13, 2).u32(46, 2).u16(50, 4139).u16(52, 65535).u8(131, 7).u8(133, 6);
    }
};

TEST_F(SystemInformationTest, EveryFieldIsShown)
{
    deliver(record().u16(184, 12345).u32(42, 1));
    EXPECT_EQ(display(),
        "{\"k1xRoamingHome\": \"ON [1]\", \"kSystemId\": \"4139\", \"kNetworkId\": \"65535\", \"kPacketZoneId\": "
        "\"7\", \"kBaseId\": \"12345\", \"kProtocolRevision\": \"6\"}");
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SystemInformationTest, BaseStationIsZeroInARecordThatEndsBefore)
{
    deliver(record(171));
    EXPECT_EQ(shown("kBaseId"), "\"0\"");
    EXPECT_EQ(shown("kProtocolRevision"), "\"6\"");
}

TEST_F(SystemInformationTest, ShortRecordIsRefused)
{
    deliver(record(170));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x134f is 170 bytes long but must be at least 171 bytes.\n");
    EXPECT_EQ(shown("kSystemId"), "\"\"");
}

TEST_F(SystemInformationTest, VersionOneIsDropped)
{
    deliver(record().u8(13, 1));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x134f has version=1; only version 2 or higher expected; dropping.\n");
    EXPECT_EQ(shown("kSystemId"), "\"\"");
    deliver(record().u8(13, 255));
    EXPECT_EQ(shown("kSystemId"), "\"4139\"");
}

TEST_F(SystemInformationTest, OtherSystemTypesAreToldForBothIdentifiers)
{
    deliver(record().u32(46, 1));
    EXPECT_EQ(shown("kSystemId"), "\"(unknown system type 1)\"");
    EXPECT_EQ(shown("kNetworkId"), "\"(unknown system type 1)\"");
    deliver(record().u32(46, 0xFFFFFFFF));
    EXPECT_EQ(shown("kSystemId"), "\"(unknown system type -1)\"");
    EXPECT_EQ(shown("kPacketZoneId"), "\"7\"");
}

TEST_F(SystemInformationTest, RoamingIndicatorsHaveTheirTexts)
{
    const char* const texts[] = {"OFF [0]", "ON [1]", "Flashing [2]", "Out of Neighborhood [3]", "Out of Building [4]",
        "Preferred system [5]", "Available system [6]", "Alliance partner [7]", "Premium partner [8]",
        "Full service functionality [9]", "Partial service functionality [10]", "Banner ON [11]", "Banner OFF [12]",
        "ERI - 13"};
    for (std::uint32_t value = 0; value < std::size(texts); ++value) {
        deliver(record().u32(42, value));
        EXPECT_EQ(shown("k1xRoamingHome"), '"' + std::string(texts[value]) + '"');
    }
    deliver(record().u32(42, 0x80000000));
    EXPECT_EQ(shown("k1xRoamingHome"), "\"ERI - -2147483648\"");
}

} // namespace
} // namespace spectrel
