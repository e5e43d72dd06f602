#include "Sections/GSMUMTS/GSM/MobileAllocation.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class MobileAllocationTest : public SectionFixture<MobileAllocation> {
protected:
    MobileAllocationTest()
        : SectionFixture(Dictionary::make())
    {
    }
};

constexpr const char* Trace = "<4>MobileAllocation\n";

TEST_F(MobileAllocationTest, SubscribesToItsCode)
{
    EXPECT_EQ(section.getSectionName(), "Mobile Allocation");
    EXPECT_EQ(section.getLogCodeArray(), (std::vector<std::uint32_t> {0x51F8}));
}

TEST_F(MobileAllocationTest, SequenceNumberAndChannelsAreShown)
{
    deliver(0x51F8, RecordBuilder(0x51F8, 21).u8(13, 42).u8(14, 3).u16(15, 10).u16(17, 20).u16(19, 30));
    EXPECT_EQ(display(), "{\"HSN\": \"42\", \"ARFCNs\": [\"10\", \"20\", \"30\"]}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(MobileAllocationTest, NoChannelsAreAnEmptyList)
{
    deliver(0x51F8, RecordBuilder(0x51F8, 17).u8(13, 1).u8(14, 1).u16(15, 65535));
    EXPECT_EQ(display(), "{\"HSN\": \"1\", \"ARFCNs\": [\"65535\"]}");
    deliver(0x51F8, RecordBuilder(0x51F8, 15).u8(13, 255));
    EXPECT_EQ(display(), "{\"HSN\": \"255\", \"ARFCNs\": []}");
}

TEST_F(MobileAllocationTest, RecordOneByteTooShortChangesNothing)
{
    deliver(0x51F8, RecordBuilder(0x51F8, 14).u8(13, 42));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), Trace);
}

TEST_F(MobileAllocationTest, ChannelsPastTheEndOfTheRecordReadAsZeros)
{
    deliver(0x51F8, RecordBuilder(0x51F8, 18).u8(14, 4).u16(15, 10).u8(17, 20));
    EXPECT_EQ(display(), "{\"HSN\": \"0\", \"ARFCNs\": [\"10\", \"20\", \"0\", \"0\"]}");
    deliver(0x51F8, RecordBuilder(0x51F8, 15).u8(14, 255));
    EXPECT_EQ(countOf("\"0\"", shown("ARFCNs")), 255u);
}

TEST_F(MobileAllocationTest, OtherCodeIsLoggedAsUnknown)
{
    deliver(0x51F7, RecordBuilder(0x51F7, 60));
    EXPECT_EQ(display(), "{}");
    EXPECT_EQ(log(), std::string(Trace) + "<3>Received an unknown log message: 20983\n");
}

} // namespace
} // namespace spectrel
