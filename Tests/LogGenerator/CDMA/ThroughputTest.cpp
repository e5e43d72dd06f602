#include "Tests/LogGenerator/CDMA/C2KFixture.h"

#include <array>

namespace spectrel {
namespace {

class ThroughputTest : public C2KFixture {
protected:
    ThroughputTest()
        : C2KFixture({"kFLDataRate", "kRLDataRate"})
    {
    }
    /// `packets` of 128 bits.
    static RecordBuilder forward(std::uint32_t sequence, std::uint32_t packets)
    {
        return RecordBuilder(0x1192, 241).u32(13, sequence).u32(17, packets);
    }
    static RecordBuilder reverse(std::uint32_t sequence, std::uint32_t packets)
    {
        return RecordBuilder(0x127E, 1750).u32(14, sequence).u32(18, packets);
    }
    std::string forwardRate()
    {
        return shown("kFLDataRate");
    }
    std::string reverseRate()
    {
        return shown("kRLDataRate");
    }
    std::string kept(std::string_view key)
    {
        return displayText(state[key]);
    }
};

TEST_F(ThroughputTest, FirstRecordOnlyPrimesTheCounters)
{
    deliver(forward(7, 3));
    EXPECT_EQ(forwardRate(), "\"\"");
    EXPECT_EQ(kept("FLDataSeqNum"), "int 7");
    EXPECT_EQ(kept("FLDataSent"), "int 384");
    EXPECT_EQ(displayText(state[StateKey::ExtraInfo]), "{\"FLDataSeqNum1\": int 7, \"FLDataSent1\": int 384}");
}

TEST_F(ThroughputTest, RateIsTheDifferenceByTime)
{
    deliver(forward(7, 0));
    deliver(forward(9, 1000));
    EXPECT_EQ(forwardRate(), "\"62.50 kbps\"");
    EXPECT_EQ(displayText(state[StateKey::ExtraInfo]),
        "{\"FLDataSeqNum1\": int 9, \"FLDataSent1\": int 128000, \"FLDataSeqNum2\": int 7, \"FLDataSent2\": int 0}");
}

TEST_F(ThroughputTest, RepeatedSequenceLeavesTheRateAndStillMovesTheCounters)
{
    deliver(forward(1, 0));
    deliver(forward(2, 16));
    deliver(forward(2, 24));
    EXPECT_EQ(forwardRate(), "\"2.00 kbps\"");
    EXPECT_EQ(kept("FLDataSent"), "int 3072");
    deliver(forward(3, 32));
    EXPECT_EQ(forwardRate(), "\"1.00 kbps\"") << "from the repeated record on";
}

TEST_F(ThroughputTest, FallingSequenceLeavesTheRateAndStillMovesTheCounters)
{
    deliver(forward(10, 0));
    deliver(forward(11, 8));
    deliver(forward(4, 0));
    EXPECT_EQ(forwardRate(), "\"1.00 kbps\"");
    EXPECT_EQ(kept("FLDataSeqNum"), "int 4");
    deliver(forward(5, 24));
    EXPECT_EQ(forwardRate(), "\"3.00 kbps\"");
}

TEST_F(ThroughputTest, SequenceMayWrap)
{
    deliver(forward(0xFFFFFFFF, 0));
    EXPECT_EQ(kept("FLDataSeqNum"), "int -1");
    deliver(forward(1, 16));
    EXPECT_EQ(forwardRate(), "\"1.00 kbps\"");
    deliver(forward(0x7FFFFFFF, 16));
    deliver(forward(0x80000001, 32));
    EXPECT_EQ(forwardRate(), "\"1.00 kbps\"");
}

TEST_F(ThroughputTest, FallingBitsAreANegativeRate)
{
    deliver(forward(1, 8));
    deliver(forward(2, 0));
    EXPECT_EQ(forwardRate(), "\"-1.00 kbps\"");
}

TEST_F(ThroughputTest, ForwardCountersHaveTheirPacketSizes)
{
    constexpr std::array<int, 56> Bits {128, 256, 512, 1024, 0, 128, 256, 512, 1024, 0, 128, 256, 512, 1024, 0, 128,
        256, 512, 1024, 0, 128, 256, 512, 1024, 0, 512, 1024, 2048, 0, 128, 256, 512, 1024, 0, 512, 1024, 2048, 0, 1024,
        3072, 0, 512, 1024, 2048, 0, 4096, 0, 1024, 3072, 0, 4096, 0, 5120, 0, 5120, 0};
    for (std::size_t counter = 0; counter < Bits.size(); ++counter) {
        deliver(RecordBuilder(0x1192, 241).u32(17 + 4 * counter, 3));
        EXPECT_EQ(kept("FLDataSent"), "int " + std::to_string(3 * Bits[counter])) << counter;
    }
}

TEST_F(ThroughputTest, ReverseCountersHaveTheirPacketSizesInAllTheirPlaces)
{
    constexpr std::array<int, 12> Bits {128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288};
    for (std::size_t rate = 0; rate < Bits.size(); ++rate) {
        for (const std::size_t block : {0, 576, 1152}) {
            for (const std::size_t place : {18, 22, 26, 30, 306, 310, 314, 318}) {
                deliver(RecordBuilder(0x127E, 1750).u32(24 * rate + block + place, 2));
                ASSERT_EQ(kept("RLDataSent"), "int " + std::to_string(2 * Bits[rate])) << rate << ' ' << block + place;
            }
        }
        RecordBuilder others(0x127E, 1750);
        for (const std::size_t place : {34, 38, 322, 326})
            others.u32(24 * rate + place, 1);
        others.u32(1746, 1); // behind the third block
        deliver(others);
        ASSERT_EQ(kept("RLDataSent"), "int 0") << rate;
    }
}

TEST_F(ThroughputTest, SumsHaveSixtyFourBits)
{
    RecordBuilder full(0x1192, 241);
    for (std::size_t counter = 0; counter < 56; ++counter)
        full.u32(17 + 4 * counter, 0xFFFFFFFF);
    deliver(full);
    EXPECT_EQ(kept("FLDataSent"), "int " + std::to_string(0xFFFFFFFFll * 48896));
    RecordBuilder same(0x127E, 1750);
    for (const std::size_t place : {18, 22, 26, 30, 306, 310, 314, 318})
        same.u32(place, 0xFFFFFFFF);
    deliver(same);
    EXPECT_EQ(kept("RLDataSent"), "int " + std::to_string(8 * 0xFFFFFFFFll * 128));
}

TEST_F(ThroughputTest, LinksAreCountedApart)
{
    deliver(forward(1, 0));
    deliver(reverse(100, 0));
    deliver(forward(2, 8));
    deliver(reverse(104, 64));
    EXPECT_EQ(forwardRate(), "\"1.00 kbps\"");
    EXPECT_EQ(reverseRate(), "\"2.00 kbps\"");
    EXPECT_EQ(displayText(state[StateKey::ExtraInfo]),
        "{\"FLDataSeqNum1\": int 2, \"FLDataSent1\": int 1024, \"RLDataSeqNum1\": int 104, \"RLDataSent1\": int 8192, "
        "\"FLDataSeqNum2\": int 1, \"FLDataSent2\": int 0, \"RLDataSeqNum2\": int 100, \"RLDataSent2\": int 0}");
}

TEST_F(ThroughputTest, StoredValueThatIsNoNumberPrimesAnew)
{
    deliver(forward(1, 0));
    deliver(forward(2, 8));
    state.set("FLDataSent", "text");
    deliver(forward(3, 16));
    EXPECT_EQ(forwardRate(), "\"\"");
}

TEST_F(ThroughputTest, ShortRecordsAreRefused)
{
    deliver(forward(1, 0).shrink(240));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x1192 is 240 bytes long but must be at least 241 bytes.\n");
    deliver(reverse(1, 0).shrink(1749));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x127e is 1749 bytes long but must be at least 1750 bytes.\n");
    EXPECT_FALSE(state.contains("FLDataSent") || state.contains("RLDataSent"));
    deliver(RecordBuilder(0x1192, 242));
    deliver(RecordBuilder(0x127E, 1751));
    EXPECT_EQ(log.takeLog(), "");
}

} // namespace
} // namespace spectrel
