#include "Telephony/Encoders/BitPacker.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(BitPackerTest, FieldsFollowOneAnotherFromTheLowestBit)
{
    EXPECT_EQ(BitPacker().field(3, 5).field(5, 0x1F).bytes(), (Bytes {0xFD}));
    EXPECT_EQ(BitPacker().field(9, 0x1FF).gap(3).field(4, 0xA).bytes(), (Bytes {0xFF, 0xA1}));
    EXPECT_EQ(BitPacker().gap(4).field(16, 0xBEEF).bytes(), (Bytes {0xF0, 0xEE, 0x0B}));
}

TEST(BitPackerTest, OnlyAFieldsOwnBitsAreTaken)
{
    EXPECT_EQ(BitPacker().field(2, 0xFFFFFFFF).field(6, 0).bytes(), (Bytes {0x03}));
}

TEST(BitPackerTest, NothingPackedIsNothing)
{
    EXPECT_TRUE(BitPacker().bytes().empty());
    EXPECT_EQ(BitPacker().field(32, 0x04030201).bytes(), (Bytes {1, 2, 3, 4}));
}

TEST(LevelStepsTest, AreTheNearestWithinTheField)
{
    EXPECT_EQ(levelSteps(-140, -140, 4, 9), 0u);
    EXPECT_EQ(levelSteps(-139.88, -140, 4, 9), 0u);
    EXPECT_EQ(levelSteps(-139.87, -140, 4, 9), 1u);
    EXPECT_EQ(levelSteps(-150, -140, 4, 9), 0u) << "below the lowest";
    EXPECT_EQ(levelSteps(0, -140, 4, 9), 511u) << "above what the field can hold";
    EXPECT_EQ(levelSteps(-96, -140, 0.5, 6), 22u);
}

} // namespace
} // namespace spectrel
