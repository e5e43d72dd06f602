#include "Records/RecordView.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(RecordViewTest, ReadsLittleEndianAndZeroPastTheEnd)
{
    const Bytes bytes {0x01, 0x02, 0x03, 0x84, 0xFF};
    const RecordView record(bytes);
    EXPECT_EQ(record.u8(4), 0xFF);
    EXPECT_EQ(record.u8(5), 0);
    EXPECT_EQ(record.u16(1), 0x0302);
    EXPECT_EQ(record.u16(4), 0x00FF);
    EXPECT_EQ(record.s16(3), -124);
    EXPECT_EQ(record.u32(0), 0x84030201u);
    EXPECT_EQ(record.u32(3), 0x0000FF84u);
    EXPECT_EQ(record.u32(static_cast<std::size_t>(-1)), 0x03020100u) << "an offset that wraps stays within the rules";
    EXPECT_EQ(record.from(4).size(), 1u);
    EXPECT_TRUE(record.from(5).empty());
    EXPECT_TRUE(record.from(6).empty());
}

TEST(RecordViewTest, BitsRunAcrossBytesFromTheLowest)
{
    const Bytes bytes {0b1010'0000, 0b0000'0011};
    const RecordView record(bytes);
    EXPECT_EQ(record.bits(0, 5, 3), 0b101u);
    EXPECT_EQ(record.bits(0, 7, 3), 0b111u);
    EXPECT_EQ(record.bits(1, 0, 1), 1u);
    EXPECT_EQ(record.bits(0, 0, 16), 0x03A0u);
}

} // namespace
} // namespace spectrel
