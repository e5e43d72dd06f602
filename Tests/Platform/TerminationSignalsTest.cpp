#include "Platform/Qt/TerminationSignals.h"
#include "Platform/Qt/QtRunLoop.h"

#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <memory>
#include <vector>

namespace spectrel {
namespace {

TEST(TerminationSignalsTest, SignalsBecomeCallsOnTheMainQueue)
{
    QtRunLoop loop;
    std::vector<int> signals;
    const TerminationSignals watched([&](int signal) { signals.push_back(signal); });
    ::raise(SIGTERM);
    ::raise(SIGINT);
    EXPECT_TRUE(signals.empty());
    ASSERT_TRUE(loop.runUntil([&] { return signals.size() == 2; }, std::chrono::seconds(60)));
    EXPECT_THAT(signals, testing::ElementsAre(SIGTERM, SIGINT));
}

TEST(TerminationSignalsTest, HandlerMayEndTheWatchAndTheFormerActionReturns)
{
    QtRunLoop loop;
    std::unique_ptr<TerminationSignals> watched;
    watched = std::make_unique<TerminationSignals>([&](int) { watched.reset(); });
    ::raise(SIGTERM);
    ASSERT_TRUE(loop.runUntil([&] { return !watched; }, std::chrono::seconds(60)));
    struct sigaction action = {};
    ::sigaction(SIGTERM, nullptr, &action);
    EXPECT_EQ(action.sa_handler, SIG_DFL);
}

} // namespace
} // namespace spectrel
