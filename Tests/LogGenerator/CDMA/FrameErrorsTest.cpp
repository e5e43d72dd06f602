#include "Tests/LogGenerator/CDMA/C2KFixture.h"

namespace spectrel {
namespace {

constexpr std::uint8_t Paging = 6;
constexpr std::uint8_t Traffic = 8;

class FrameErrorsTest : public C2KFixture {
protected:
    FrameErrorsTest()
        : C2KFixture({"k1xTrafficFER"})
    {
    }
    void deliverFrame(std::uint8_t error)
    {
        Bytes demodulation(21);
        demodulation[20] = error;
        deliver(SubpacketRecord(0x119D).add(10, Bytes(3)).add(11, demodulation));
    }
    void deliverState(std::uint8_t deviceState)
    {
        deliver(SubpacketRecord(0x119C).add(1, {deviceState}).add(2, Bytes(10)).add(3, Bytes(8)).add(4, {}));
    }
    std::string rate()
    {
        return shown("k1xTrafficFER");
    }
};

TEST_F(FrameErrorsTest, FirstErrorIsASixtyFourthAndFadesWithGoodFrames)
{
    deliverFrame(1);
    EXPECT_EQ(rate(), "\"1.56%\"");
    EXPECT_EQ(state["TrafficFER"].real(), 1.0 / 64);
    deliverFrame(0);
    EXPECT_EQ(rate(), "\"1.54%\"");
    EXPECT_EQ(state["TrafficFER"].real(), 63.0 / 64 / 64);
}

TEST_F(FrameErrorsTest, GoodFramesAloneAreNoErrors)
{
    deliverFrame(0);
    EXPECT_EQ(rate(), "\"0.00%\"");
}

TEST_F(FrameErrorsTest, AnyValueButZeroIsOneError)
{
    deliverFrame(255);
    EXPECT_EQ(rate(), "\"1.56%\"");
}

TEST_F(FrameErrorsTest, AverageIsKeptInSinglePrecision)
{
    float expected = 0;
    for (int frame = 0; frame < 500; ++frame) {
        deliverFrame(frame % 3 == 0);
        const float faded = 63.0F / 64 * expected;
        expected = (frame % 3 == 0 ? 1.0F / 64 : 0) + faded;
        ASSERT_EQ(state["TrafficFER"].real(), static_cast<double>(expected)) << frame;
    }
}

TEST_F(FrameErrorsTest, AverageThatIsNoNumberIsNone)
{
    state.set("TrafficFER", "text");
    deliverState(Paging);
    EXPECT_EQ(rate(), "\"\"");
    deliverFrame(1);
    EXPECT_EQ(rate(), "\"1.56%\"");
}

TEST_F(FrameErrorsTest, EndOfTrafficShowsTheOldRateOnceAndStartsAfresh)
{
    deliverFrame(1);
    deliverState(Traffic);
    EXPECT_EQ(rate(), "\"1.56%\"");
    deliverState(Paging);
    EXPECT_EQ(rate(), "\"1.56% (old)\"");
    EXPECT_FALSE(state.contains("TrafficFER"));
    deliverState(Paging);
    EXPECT_EQ(rate(), "\"1.56% (old)\"") << "nothing clears it";
    deliverFrame(0);
    EXPECT_EQ(rate(), "\"0.00%\"");
}

TEST_F(FrameErrorsTest, RecordMustReachTheSubpackets)
{
    deliver(RecordBuilder(0x119D, 16));
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x119d is 16 bytes long but must be at least 17 bytes.\n");
    EXPECT_EQ(rate(), "\"\"");
}

TEST_F(FrameErrorsTest, MissingSubpacketIsTold)
{
    deliver(SubpacketRecord(0x119D).add(10, Bytes(30)));
    EXPECT_EQ(log.takeLog(), "<4>Log code 0x119d: missing traffic demod subpacket.\n");
    EXPECT_EQ(rate(), "\"\"");
    EXPECT_FALSE(state.contains("TrafficFER"));
}

TEST_F(FrameErrorsTest, SubpacketTooShortForItsFlagReadsAGoodFrame)
{
    deliver(SubpacketRecord(0x119D).add(11, Bytes(20)));
    EXPECT_EQ(rate(), "\"0.00%\"");
}

} // namespace
} // namespace spectrel
