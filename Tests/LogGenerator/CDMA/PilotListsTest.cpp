#include "Tests/LogGenerator/CDMA/C2KFixture.h"

namespace spectrel {
namespace {

class ActiveSetPilotsTest : public C2KFixture {
protected:
    ActiveSetPilotsTest()
        : C2KFixture({"kActiveSetPilots"})
    {
    }
    static RecordBuilder record(std::uint8_t pilots)
    {
        return RecordBuilder(0x12B6, 25 + 12u * pilots).u8(15, pilots);
    }
    std::string pilots()
    {
        return shown("kActiveSetPilots");
    }
};

TEST_F(ActiveSetPilotsTest, NoPilotIsNone)
{
    deliver(record(0));
    EXPECT_EQ(pilots(), "\"(none)\"");
}

TEST_F(ActiveSetPilotsTest, PilotsAreListedByIndexAndPN)
{
    deliver(record(3).u16(25, 168).u16(27, 512).u16(37, 4).u16(39, 51).u16(49, 0xFFFF).u16(51, 0xFFFF));
    EXPECT_EQ(pilots(),
        "{\"_sorted\": \"_sorted\", \"0;168\": \"+0.00 dB\", \"1;4\": \"-10.02 dB\", \"2;65535\": \"+21.07 dB\"}");
}

TEST_F(ActiveSetPilotsTest, EnergyOfNothingIsInfinitelyWeak)
{
    deliver(record(1));
    EXPECT_EQ(pilots(), "{\"_sorted\": \"_sorted\", \"0;0\": \"-inf dB\"}");
}

TEST_F(ActiveSetPilotsTest, NewListReplacesTheOldOne)
{
    deliver(record(2).u16(27, 512).u16(39, 512));
    deliver(record(1).u16(25, 9).u16(27, 512));
    EXPECT_EQ(pilots(), "{\"_sorted\": \"_sorted\", \"0;9\": \"+0.00 dB\"}");
}

TEST_F(ActiveSetPilotsTest, HeadMustBeWhole)
{
    deliver(record(0).shrink(24));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x12b6 is 24 bytes long but must be at least 25 bytes.\n");
    EXPECT_EQ(pilots(), "\"\"");
}

TEST_F(ActiveSetPilotsTest, PilotsMustAllBeThereAndMayBeFollowed)
{
    deliver(record(2).shrink(48));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x12b6 is 48 bytes long, but has 2 substructs.\n");
    EXPECT_EQ(pilots(), "\"\"");
    deliver(record(2).u8(15, 1).u16(27, 512));
    EXPECT_EQ(log.takeLog(), "");
    EXPECT_EQ(pilots(), "{\"_sorted\": \"_sorted\", \"0;0\": \"+0.00 dB\"}");
}

class FingersTest : public C2KFixture {
protected:
    FingersTest()
        : C2KFixture({"kFingerC2I"})
    {
    }
    static RecordBuilder record(std::uint8_t fingers)
    {
        return RecordBuilder(0x108A, 23 + 14u * fingers).u8(22, fingers);
    }
    std::string fingers()
    {
        return shown("kFingerC2I");
    }
};

TEST_F(FingersTest, NoFingerIsNone)
{
    deliver(record(0));
    EXPECT_EQ(fingers(), "\"(none)\"");
}

TEST_F(FingersTest, OneUnassignedFingerIsNone)
{
    deliver(record(1).u16(23, 0xFFFF).u16(29, 512));
    EXPECT_EQ(fingers(), "\"(none)\"");
}

TEST_F(FingersTest, UnassignedFingersAreSkippedAndStillCounted)
{
    deliver(record(3).u16(23, 12).u16(29, 512).u16(37, 0xFFFF).u16(51, 12).u16(57, 1024));
    EXPECT_EQ(fingers(), "{\"_sorted\": \"_sorted\", \"0;12\": \"+0.00 dB\", \"2;12\": \"+3.01 dB\"}");
}

TEST_F(FingersTest, HeadMustBeWhole)
{
    deliver(record(0).shrink(22));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x108a is 22 bytes long but must be at least 23 bytes.\n");
    EXPECT_EQ(fingers(), "\"\"");
}

TEST_F(FingersTest, LengthMustFitTheFingersExactly)
{
    deliver(record(2).u8(22, 1));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x108a has bad length of 51 bytes, but has 1 substructs (size=23).\n");
    deliver(record(2).shrink(50));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x108a has bad length of 50 bytes, but has 2 substructs (size=23).\n");
    EXPECT_EQ(fingers(), "\"\"");
}

} // namespace
} // namespace spectrel
