#include "LogGenerator/CDMA/Subpackets.h"

#include "Tests/LogGenerator/CDMA/C2KFixture.h"

namespace spectrel {
namespace {

class SubpacketsTest : public testing::Test {
protected:
    LogRecorder log;
};

TEST_F(SubpacketsTest, FoundBehindOthersInAnyOrder)
{
    const SubpacketRecord record = SubpacketRecord(0x119D).add(3, Bytes(5)).add(11, Bytes(2)).add(1, {});
    EXPECT_EQ(findSubpacket(log, ByteView(record), 3), 17u);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 11), 26u);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 1), 32u);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 2), std::nullopt);
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SubpacketsTest, FirstOfTwoIsFound)
{
    const SubpacketRecord record = SubpacketRecord(0x119D).add(5, {}).add(11, {}).add(11, {});
    EXPECT_EQ(findSubpacket(log, ByteView(record), 11), 21u);
}

TEST_F(SubpacketsTest, CountOfZeroHasNone)
{
    const SubpacketRecord record = SubpacketRecord(0x119D).add(11, {}).count(0);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 11), std::nullopt);
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SubpacketsTest, NoneIsSoughtBeyondTheCount)
{
    const SubpacketRecord record = SubpacketRecord(0x119D).add(1, {}).add(11, {}).count(1);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 11), std::nullopt);
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SubpacketsTest, SizeOfZeroStaysInItsPlaceAndEndsWithTheCount)
{
    const SubpacketRecord record = SubpacketRecord(0x119D).addWithSize(5, 0, {}).add(11, {}).count(255);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 11), std::nullopt);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 5), 17u);
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(SubpacketsTest, MayReachSixteenBytesPastTheRecordsEnd)
{
    // 21 bytes of record; the bound is 38, and the subpacket starts at 17.
    const SubpacketRecord inside = SubpacketRecord(0x119D).addWithSize(11, 20, {});
    EXPECT_EQ(findSubpacket(log, ByteView(inside), 11), 17u);
    EXPECT_EQ(log.takeLog(), "");
    const SubpacketRecord atBound = SubpacketRecord(0x119D).addWithSize(11, 21, {});
    EXPECT_EQ(findSubpacket(log, ByteView(atBound), 11), std::nullopt);
    EXPECT_EQ(log.takeLog(), "<3>Log code error in subpkt#0: bad size (21).\n");
}

TEST_F(SubpacketsTest, SizeIsTestedBeforeTheId)
{
    const SubpacketRecord record = SubpacketRecord(0x119D).add(1, {}).add(2, {}).addWithSize(11, 0xFFFF, {});
    EXPECT_EQ(findSubpacket(log, ByteView(record), 11), std::nullopt);
    EXPECT_EQ(log.takeLog(), "<3>Log code error in subpkt#2: bad size (65535).\n");
    EXPECT_EQ(findSubpacket(log, ByteView(record), 2), 21u);
    EXPECT_EQ(log.takeLog(), "") << "a later one is not looked at";
}

TEST_F(SubpacketsTest, SearchGoesOnInTheZerosPastTheRecordsEnd)
{
    const SubpacketRecord record = SubpacketRecord(0x119D).addWithSize(5, 20, {}).count(255);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 11), std::nullopt);
    EXPECT_EQ(findSubpacket(log, ByteView(record), 0), 37u) << "a size of 0 and an id of 0";
    EXPECT_EQ(log.takeLog(), "");
}

} // namespace
} // namespace spectrel
