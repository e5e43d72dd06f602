#include "Telephony/Encoders/RecordWriter.h"

#include "Telephony/Encoders/LTERecords.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Simulator/LTE/LTEWorld.h"
#include "Tests/Fakes/DisplayText.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

constexpr Moment Epoch1980 = std::chrono::sys_days(std::chrono::year(1980) / 1 / 6);

LTECell cell()
{
    LTECell some;
    some.identity = 0x0123456;
    some.physicalCellId = 0x01F7;
    some.downlinkChannel = 1300;
    some.uplinkChannel = 19300;
    some.band = 3;
    some.resourceBlocks = 100;
    some.antennas = 4;
    some.trackingArea = 0xABCD;
    return some;
}

TEST(RecordWriterTest, HeaderIsTypeLengthCodeAndTimestamp)
{
    const Bytes record = RecordWriter(0xB0C2, Epoch1980 + std::chrono::microseconds(2500)).u8(7).take();
    EXPECT_EQ(record, (Bytes {0x01, 13, 0, 0xC2, 0xB0, 0, 0, 2, 0, 0, 0, 0, 0, 7}));
}

TEST(RecordWriterTest, ExtraStreamHasItsOwnTypeAndThePlainCode)
{
    const Bytes record = RecordWriter(0xFF0001, Epoch1980).take();
    EXPECT_EQ(record[0], 0xFF);
    EXPECT_EQ(record[3], 0x01);
    EXPECT_EQ(record[4], 0x00);
}

TEST(RecordWriterTest, TimestampCountsEighthHundredthsOfASecondInTheUpper48Bits)
{
    EXPECT_EQ(itemTimestamp(Epoch1980), 0u);
    EXPECT_EQ(itemTimestamp(Epoch1980 - std::chrono::hours(1)), 0u);
    EXPECT_EQ(itemTimestamp(Epoch1980 + std::chrono::seconds(1)), 800ull << 16);
}

TEST(RecordWriterTest, ServingCellRecordIsLaidOutByteForByte)
{
    const Bytes record = lteServingCellRecord(cell(), Epoch1980);
    const Bytes payload {2, 0xF7, 0x01, 0x14, 0x05, 0x64, 0x4B, 100, 100, 0x56, 0x34, 0x12, 0x00, 0xCD, 0xAB, 3, 0, 0,
        0, 0, 0, 0, 0, 0, 0};
    ASSERT_EQ(record.size(), 38u);
    EXPECT_EQ(Bytes(record.begin() + 13, record.end()), payload);
}

TEST(RecordWriterTest, AntennasRecordHasTheAntennasAtOffset20)
{
    const Bytes record = lteAntennasRecord(cell(), Epoch1980);
    ASSERT_EQ(record.size(), 22u);
    EXPECT_EQ(record[20], 4);
}

TEST(RecordWriterTest, CellInformationTellsTheServingCellFirst)
{
    const LTEWorld world(Scene::Drive, 1);
    const Bytes record = lteCellInformationRecord(world, Epoch1980);
    const auto cells = parsePropertyList(ByteView(record).subspan(13));
    ASSERT_TRUE(cells && cells->list());
    EXPECT_EQ(cells->list()->count(), 5u);
    const auto& serving = *(*cells->list())[0].dictionary();
    EXPECT_EQ(serving["kRKCellMonitorCellType"], Value("kRKCellMonitorCellTypeServing"));
    EXPECT_EQ(serving["kRKCellMonitorPID"].int32(), world.servingCell().physicalCellId);
}

} // namespace
} // namespace spectrel
