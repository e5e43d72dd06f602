#include "Sections/GSMUMTS/UMTS/BLER.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class BLERTest : public SectionFixture<BLER> {
protected:
    BLERTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>BLER\n";

TEST_F(BLERTest, SubscribesToItsCode)
{
    EXPECT_EQ(section.getSectionName(), "BLER");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x4116}));
}

TEST_F(BLERTest, WindowAndChannelsAreShownInOrder)
{
    RecordBuilder record(0x4116, 16 + 2 * 9);
    record.u8(13, 2).u16(14, 65535);
    record.u8(16, 1).u32(17, 1000).u32(21, 12);
    record.u8(25, 255).u32(26, 0xFFFFFFFF).u32(30, 0x80000000);
    deliver(0x4116, record);
    EXPECT_EQ(display(),
        "{\"Window Size\": \"65535\", \"Transport Channels\": ["
        "{\"Transport Channel ID\": \"1\", \"CRC Received\": \"1000\", \"CRC Received in Error\": \"12\"}, "
        "{\"Transport Channel ID\": \"255\", \"CRC Received\": \"-1\", \"CRC Received in Error\": \"-2147483648\"}]}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(BLERTest, NoChannelsAreAnEmptyListAndTheWindowIsUpdated)
{
    deliver(0x4116, RecordBuilder(0x4116, 25).u8(13, 1).u16(14, 50));
    deliver(0x4116, RecordBuilder(0x4116, 16).u16(14, 100));
    EXPECT_EQ(display(), "{\"Window Size\": \"100\", \"Transport Channels\": []}");
}

TEST_F(BLERTest, RecordOneByteTooShortChangesNothing)
{
    deliver(0x4116, RecordBuilder(0x4116, 15));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(BLERTest, ChannelsPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x4116, RecordBuilder(0x4116, 18).u8(13, 2).u8(16, 3).u8(17, 4));
    EXPECT_EQ(display(),
        "{\"Window Size\": \"0\", \"Transport Channels\": ["
        "{\"Transport Channel ID\": \"3\", \"CRC Received\": \"4\", \"CRC Received in Error\": \"0\"}, "
        "{\"Transport Channel ID\": \"0\", \"CRC Received\": \"0\", \"CRC Received in Error\": \"0\"}]}");
}

TEST_F(BLERTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x4117, RecordBuilder(0x4117, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 16663\n");
}

} // namespace
} // namespace spectrel
