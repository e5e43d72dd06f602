#include "Telephony/Encoders/GPRSRecords.h"

#include "Tests/Telephony/RecordBytes.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

/// Every parameter its own value, so that none can stand for another.
GPRSParameters parameters()
{
    GPRSParameters some;
    some.si13Position = 11;
    some.networkControlOrder = 12;
    some.packetFlowContexts = 13;
    some.priorityAccessThreshold = 14;
    some.t3192 = 15;
    some.drxTimerMax = 16;
    some.elevenBitAccessBursts = true;
    some.hasPBCCH = true;
    some.psiStatus = 17;
    some.countLR = 18;
    some.countHR = 19;
    some.extendedMeasurementOrder = 20;
    some.packetSIStatus = true;
    return some;
}

TEST(GPRSRecordsTest, SystemInformationPositionIsTheSecondByte)
{
    const Bytes record = gprsSystemInformationRecord(parameters(), Epoch1980);
    EXPECT_EQ(codeOf(record), 0x51F4u);
    EXPECT_EQ(payloadOf(record), (Bytes {0, 11}));
}

TEST(GPRSRecordsTest, AccessIsFlowContextsThresholdAndOrder)
{
    const Bytes record = gprsAccessRecord(parameters(), Epoch1980);
    EXPECT_EQ(codeOf(record), 0x51F5u);
    EXPECT_EQ(payloadOf(record), (Bytes {13, 14, 12, 0, 0}));
}

TEST(GPRSRecordsTest, TimersStandFromTheThirdByte)
{
    const Bytes record = gprsTimersRecord(parameters(), Epoch1980);
    EXPECT_EQ(codeOf(record), 0x51F6u);
    ASSERT_EQ(record.size(), 24u);
    EXPECT_EQ(part(record, 13, 5), (Bytes {0, 0, 15, 16, 1}));
}

TEST(GPRSRecordsTest, BroadcastChannelIsTheFirstByte)
{
    const Bytes record = gprsBroadcastRecord(parameters(), Epoch1980);
    EXPECT_EQ(codeOf(record), 0x51FBu);
    ASSERT_EQ(record.size(), 34u);
    EXPECT_EQ(record[13], 1);
}

TEST(GPRSRecordsTest, StatusEndsWithThePacketSystemInformation)
{
    const Bytes record = gprsStatusRecord(parameters(), Epoch1980);
    EXPECT_EQ(codeOf(record), 0x51FDu);
    ASSERT_EQ(record.size(), 35u);
    EXPECT_EQ(part(record, 13, 4), (Bytes {17, 18, 19, 20}));
    EXPECT_EQ(part(record, 32, 3), (Bytes {0, 1, 0}));
}

} // namespace
} // namespace spectrel
