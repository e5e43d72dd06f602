#include "Telephony/Encoders/UTRANRecords.h"
#include "Tests/Analysis/Events/LTEEvents.h"

#include <gmock/gmock.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class FindingsTest : public LTEEvents {
protected:
    /// One second on, with a measurement of the serving cell.
    void step(const Named& cell, int srxlev, double rsrp = -100)
    {
        pass(1s);
        idle(cell, srxlev, rsrp);
    }
    std::string found()
    {
        finish();
        return findings();
    }
};

TEST_F(FindingsTest, ThereAndBackSoonIsAPingPong)
{
    remark();
    idle(A, 20);
    step(B, 20);
    pass(8s);
    idle(A, 20);
    EXPECT_EQ(found(), "ping-pong ");
    const Event event = all(EventKind::Finding)[0];
    EXPECT_EQ(event.seconds, 8 + 0);
    EXPECT_EQ(event.evidence.size(), 3u);
}

TEST_F(FindingsTest, ThereAndBackLaterIsNone)
{
    remark();
    idle(A, 20);
    step(B, 20);
    pass(11s);
    idle(A, 20);
    EXPECT_EQ(found(), "");
}

TEST_F(FindingsTest, AnotherCellThanTheFirstIsNoPingPong)
{
    remark();
    idle(A, 20);
    step(B, 20);
    step(Low, 20);
    EXPECT_EQ(found(), "");
}

TEST_F(FindingsTest, AThresholdIsSettable)
{
    Thresholds thresholds;
    ASSERT_TRUE(thresholds.set("ping-pong-time=20"));
    remark(thresholds);
    idle(A, 20);
    step(B, 20);
    pass(11s);
    idle(A, 20);
    EXPECT_EQ(found(), "ping-pong ");
}

TEST_F(FindingsTest, ACellBelowItsOwnMinimumIsAHole)
{
    remark();
    idle(A, 5);
    for (int second = 0; second < 8; ++second)
        step(A, -2 - second);
    step(A, 3);
    step(A, 3);
    EXPECT_EQ(found(), "hole ");
    EXPECT_THAT(all(EventKind::Finding)[0].text, testing::HasSubstr("Srxlev down to"));
}

TEST_F(FindingsTest, AShortDipIsNoHole)
{
    remark();
    idle(A, 5);
    step(A, 4);
    step(A, -2);
    step(A, -2);
    step(A, 3);
    step(A, 3);
    EXPECT_EQ(found(), "");
}

TEST_F(FindingsTest, AMuchStrongerNeighbourThatIsNotTakenIsRemarked)
{
    remark();
    for (int second = 0; second < 16; ++second) {
        step(A, 20, -100);
        neighbour(B, -92);
    }
    EXPECT_EQ(found(), "better-neighbour ");
    const Event event = all(EventKind::Finding)[0];
    EXPECT_THAT(event.text, testing::HasSubstr("8 dB stronger"));
    EXPECT_THAT(event.text, testing::HasSubstr("hysteresis"));
    EXPECT_GE(*event.seconds, 10);
}

TEST_F(FindingsTest, TheSearchThresholdKeepsThePhoneFromAnotherCarrier)
{
    remark();
    for (int second = 0; second < 16; ++second) {
        step(A, 40, -100);
        neighbour(Low, -92);
    }
    EXPECT_EQ(found(), "better-neighbour ");
    EXPECT_THAT(all(EventKind::Finding)[0].text, testing::HasSubstr("above its search threshold of 20 dB"));
}

TEST_F(FindingsTest, ASlightlyStrongerNeighbourIsNone)
{
    remark();
    for (int second = 0; second < 16; ++second) {
        step(A, 20, -100);
        neighbour(B, -96);
    }
    EXPECT_EQ(found(), "");
}

TEST_F(FindingsTest, ANeighbourThatIsTakenInTimeIsNone)
{
    remark();
    for (int second = 0; second < 6; ++second) {
        step(A, 20, -100);
        neighbour(B, -92);
    }
    step(B, 28, -92);
    EXPECT_EQ(found(), "");
}

TEST_F(FindingsTest, SeveralEqualNeighboursAreAPollution)
{
    remark();
    for (int second = 0; second < 8; ++second) {
        step(A, 20, -100);
        std::vector<LTEIdleNeighbour> heard(3);
        for (std::size_t index = 0; index < heard.size(); ++index) {
            heard[index].physicalCellId = static_cast<std::uint16_t>(300 + index);
            heard[index].measured = heard[index].average = lteLevels(-103, -73, 50);
        }
        deliver(lteNeighbourMeasurementRecord({A.channel, -122, heard}, time));
    }
    EXPECT_EQ(found(), "pilot-pollution ");
}

TEST_F(FindingsTest, TwoEqualNeighboursAreNone)
{
    remark();
    for (int second = 0; second < 8; ++second) {
        step(A, 20, -100);
        std::vector<LTEIdleNeighbour> heard(2);
        for (std::size_t index = 0; index < heard.size(); ++index) {
            heard[index].physicalCellId = static_cast<std::uint16_t>(300 + index);
            heard[index].measured = heard[index].average = lteLevels(-103, -73, 50);
        }
        deliver(lteNeighbourMeasurementRecord({A.channel, -122, heard}, time));
    }
    EXPECT_EQ(found(), "");
}

TEST_F(FindingsTest, ACellThatServesAgainAfterThreeOthersOvershoots)
{
    remark();
    idle(A, 20);
    for (const std::uint16_t pci : std::vector<std::uint16_t> {101, 102, 103}) {
        pass(20s);
        idle({1300, pci, 5}, 20);
    }
    pass(20s);
    idle(A, 20);
    EXPECT_EQ(found(), "overshoot ");
}

TEST_F(FindingsTest, AfterTwoOthersItDoesNot)
{
    remark();
    idle(A, 20);
    for (const std::uint16_t pci : std::vector<std::uint16_t> {101, 102}) {
        pass(20s);
        idle({1300, pci, 5}, 20);
    }
    pass(20s);
    idle(A, 20);
    EXPECT_EQ(found(), "");
}

TEST_F(FindingsTest, ALongTimeWithoutServiceIsRemarked)
{
    remark();
    idle(A, 20);
    for (int second = 0; second < 29; ++second) {
        pass(1s);
        neighbour(B, -130);
    }
    pass(2s);
    idle(A, 20);
    EXPECT_EQ(found(), "no-service ");
    EXPECT_EQ(all(EventKind::Finding)[0].seconds, 31);
}

TEST_F(FindingsTest, AShortTimeIsNot)
{
    remark();
    idle(A, 20);
    for (int second = 0; second < 20; ++second) {
        pass(1s);
        neighbour(B, -130);
    }
    idle(A, 20);
    EXPECT_EQ(all(EventKind::ServiceLost).size(), 1u);
    EXPECT_EQ(found(), "");
}

/// A UTRAN phone, whose neighbour list says which cells the network has named.
class MissingNeighbourTest : public EventFixture {
protected:
    MissingNeighbourTest()
        : EventFixture(Technology::UTRAN)
    {
        remark();
    }
    void listen(double detected)
    {
        UTRANCell cell;
        cell.identity = 0xC0001;
        cell.channel = 10054;
        for (int second = 0; second < 8; ++second) {
            pass(1s);
            deliver(utranServingCellRecord(cell, true, time));
            const std::vector<UTRANNeighbour> cells {
                {10054, 1, -80, UTRANCellSet::Active, true}, {10054, 2, detected, UTRANCellSet::Detected, true}};
            deliver(utranNeighbourRecord(cells, time));
        }
        finish();
    }
};

TEST_F(MissingNeighbourTest, AStrongCellThatIsNotNamedIsMissing)
{
    listen(-81);
    EXPECT_EQ(findings(), "missing-neighbour ");
}

TEST_F(MissingNeighbourTest, AWeakOneIsNot)
{
    listen(-90);
    EXPECT_EQ(findings(), "");
}

} // namespace
} // namespace spectrel
