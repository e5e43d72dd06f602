#include "Telephony/Encoders/RecordWriter.h"

#include "Tests/Telephony/RecordBytes.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

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

} // namespace
} // namespace spectrel
