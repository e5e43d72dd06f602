#include "Platform/Qt/QtRunLoop.h"

#include <chrono>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <sys/resource.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using std::chrono::steady_clock;

class QtRunLoopTest : public testing::Test {
protected:
    bool turnUntil(const std::function<bool()>& done)
    {
        return loop.runUntil(done, 60s);
    }
    QtRunLoop loop;
    std::string order;
};

TEST_F(QtRunLoopTest, JobsRunInTheirOrderAfterTheCurrentOne)
{
    loop.async([&] {
        loop.async([&] { order += "c"; });
        order += "a";
    });
    loop.async([&] { order += "b"; });
    EXPECT_EQ(order, "");
    ASSERT_TRUE(turnUntil([&] { return order.size() == 3; }));
    EXPECT_EQ(order, "abc");
}

TEST_F(QtRunLoopTest, QueueThatFeedsItselfDoesNotStarveTimers)
{
    bool isOver = false;
    std::function<void()> again = [&] {
        if (!isOver)
            loop.async(again);
    };
    loop.async(again);
    loop.after(1ms, [&] { isOver = true; });
    EXPECT_TRUE(turnUntil([&] { return isOver; }));
}

TEST_F(QtRunLoopTest, DelayedJobsRunWhenDueAndNotEarlier)
{
    const auto start = steady_clock::now();
    steady_clock::duration waited {};
    loop.after(10500us, [&] {
        order += "late";
        waited = steady_clock::now() - start;
    });
    loop.after(1ms, [&] { order += "early "; });
    ASSERT_TRUE(turnUntil([&] { return order.size() == 10; }));
    EXPECT_EQ(order, "early late");
    EXPECT_GE(waited, 10500us);
}

TEST_F(QtRunLoopTest, TimerRepeatsUntilDestroyed)
{
    int ticks = 0;
    auto timer = loop.repeat(1ms, [&] { ++ticks; });
    ASSERT_TRUE(turnUntil([&] { return ticks >= 3; }));
    timer.reset();
    const int after = ticks;
    bool isLater = false;
    loop.after(5ms, [&] { isLater = true; });
    ASSERT_TRUE(turnUntil([&] { return isLater; }));
    EXPECT_EQ(ticks, after);
}

TEST_F(QtRunLoopTest, TimerMayBeDestroyedWithinItsAction)
{
    std::unique_ptr<Timer> timer;
    const auto shared = std::make_shared<std::string>("captured");
    timer = loop.repeat(1ms, [&, shared] {
        timer.reset();
        order += *shared; // the action outlives its timer
    });
    ASSERT_TRUE(turnUntil([&] { return !order.empty(); }));
    EXPECT_EQ(order, "captured");
}

TEST_F(QtRunLoopTest, MissedTicksAreNotMadeUpFor)
{
    int ticks = 0;
    const auto timer = loop.repeat(2ms, [&] {
        ++ticks;
        for (const auto start = steady_clock::now(); ticks == 1 && steady_clock::now() - start < 30ms;) { }
    });
    bool isNext = false;
    loop.after(31ms, [&] { isNext = true; });
    ASSERT_TRUE(turnUntil([&] { return isNext; }));
    EXPECT_LT(ticks, 10);
}

TEST_F(QtRunLoopTest, QuitEndsRunWithItsStatus)
{
    loop.async([&] { loop.quit(3); });
    EXPECT_EQ(loop.run(), 3);
}

TEST_F(QtRunLoopTest, RunUntilGivesUpAtItsLimit)
{
    EXPECT_FALSE(loop.runUntil([] { return false; }, 5ms));
}

TEST_F(QtRunLoopTest, JobMayTurnTheLoopItself)
{
    loop.async([&] {
        loop.async([&] { order += "inner "; });
        EXPECT_TRUE(turnUntil([&] { return !order.empty(); }));
        order += "outer";
    });
    ASSERT_TRUE(turnUntil([&] { return order.size() > 6; }));
    EXPECT_EQ(order, "inner outer");
}

TEST(QtRunLoopLifeTest, PendingJobsEndWithTheLoop)
{
    const auto witness = std::make_shared<int>();
    {
        QtRunLoop loop;
        loop.async([witness] { FAIL(); });
        loop.after(1ms, [witness] { FAIL(); });
        EXPECT_EQ(witness.use_count(), 3);
    }
    EXPECT_EQ(witness.use_count(), 1);
}

TEST_F(QtRunLoopTest, IdleLoopSleeps)
{
    rusage before = {};
    rusage after = {};
    ::getrusage(RUSAGE_THREAD, &before);
    EXPECT_FALSE(loop.runUntil([] { return false; }, 200ms));
    ::getrusage(RUSAGE_THREAD, &after);
    EXPECT_LE(after.ru_nvcsw - before.ru_nvcsw, 5); // each wake-up is a voluntary switch
}

} // namespace
} // namespace spectrel
