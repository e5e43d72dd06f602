#include "Telephony/Sources/SimulatorSource.h"

#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Telephony/Collector.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class SimulatorSourceTest : public testing::Test {
protected:
    FakeRunLoop loop;
    SimulatorSource source {loop, loop, makeBaseband(Technology::LTE, Scene::Drive, 1), 1};
    Collector collector;
};

TEST_F(SimulatorSourceTest, NewChannelGetsTheSlowRecordsAtOnce)
{
    const auto stream = source.start(collector);
    EXPECT_EQ(collector.count(0xFF, 0), 1u);
    EXPECT_EQ(collector.count(0xFF, 1), 1u);
    EXPECT_EQ(collector.count(0xFF, 2), 1u);
}

TEST_F(SimulatorSourceTest, RecordsComeSteadily)
{
    const auto stream = source.start(collector);
    collector.messages.clear();
    loop.advance(60s);
    EXPECT_EQ(collector.count(0x01, 0xC2), 150u);
    EXPECT_EQ(collector.count(0x01, 0xC1), 75u);
    EXPECT_EQ(collector.count(0xFF, 1), 12u);
    EXPECT_EQ(collector.count(0xFF, 0), 2u);
}

TEST_F(SimulatorSourceTest, ItMovesOnlyWhileSomebodyListens)
{
    EXPECT_EQ(loop.timers(), 0u);
    auto stream = source.start(collector);
    EXPECT_EQ(loop.timers(), 1u);
    stream.reset();
    EXPECT_EQ(loop.timers(), 0u);
}

TEST_F(SimulatorSourceTest, TwoChannelsSeeTheSamePhone)
{
    Collector other;
    const auto first = source.start(collector);
    const auto second = source.start(other);
    loop.advance(30s);
    EXPECT_EQ(collector.messages, other.messages);
}

TEST_F(SimulatorSourceTest, BusyClientLosesNothingOnceItTakesAgain)
{
    Collector other;
    const auto first = source.start(collector);
    const auto second = source.start(other);
    other.isFull = true;
    loop.advance(10s);
    EXPECT_LT(other.messages.size(), collector.messages.size());
    other.isFull = false;
    second->resume();
    EXPECT_EQ(collector.messages, other.messages);
}

TEST_F(SimulatorSourceTest, ChannelsEndWhenThePhoneChangesItsTechnology)
{
    SimulatorSource travelling(loop, loop, makeBaseband(Technology::LTE, Scene::Journey, 1), 1);
    auto stream = travelling.start(collector);
    unsigned changes = 0;
    travelling.setBasebandHandler([&] {
        ++changes;
        stream.reset();
    });
    while (changes == 0)
        loop.advance(1s);
    EXPECT_EQ(travelling.technology(), Technology::UTRAN);
    EXPECT_EQ(loop.timers(), 0U);
    Collector next;
    stream = travelling.start(next);
    EXPECT_FALSE(next.messages.empty());
    while (changes == 1)
        loop.advance(1s);
    EXPECT_EQ(travelling.technology(), Technology::GSM);
}

} // namespace
} // namespace spectrel
