#include "Platform/Qt/TerminationSignals.h"
#include "Platform/Qt/QtRunLoop.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <memory>
#include <sys/resource.h>
#include <system_error>
#include <vector>

namespace spectrel {
namespace {

TEST(TerminationSignalsTest, SignalsBecomeCallsOnTheMainQueue)
{
    QtRunLoop loop;
    std::vector<int> signals;
    const TerminationSignals watched([&](int signal) { signals.push_back(signal); }, {SIGUSR1});
    ::raise(SIGUSR1);
    ::raise(SIGTERM);
    EXPECT_TRUE(signals.empty());
    ASSERT_TRUE(loop.runUntil([&] { return signals.size() == 2; }, std::chrono::seconds(60)));
    EXPECT_THAT(signals, testing::ElementsAre(SIGUSR1, SIGTERM));
}

/// The loop does not turn, as in a program that is stuck.
void beAskedToEndTwice()
{
    QtRunLoop loop;
    const TerminationSignals watched([](int) {});
    ::raise(SIGTERM);
    ::raise(SIGINT);
}

TEST(TerminationSignalsDeathTest, SecondSignalEndsAtOnce)
{
    EXPECT_EXIT(beAskedToEndTwice(), testing::KilledBySignal(SIGINT), "");
}

void startWithoutDescriptors()
{
    // Sanitizers look at a class' first object with descriptors of their own, and remember it.
    std::fputs(std::system_error(EINTR, std::generic_category()).what(), stderr);
    rlimit usual {};
    ::getrlimit(RLIMIT_NOFILE, &usual);
    const rlimit few {3, usual.rlim_max};
    ::setrlimit(RLIMIT_NOFILE, &few);
    try {
        const QtRunLoop loop;
    } catch (const std::system_error& error) {
        ::setrlimit(RLIMIT_NOFILE, &usual);
        std::fputs(error.what(), stderr);
        std::_Exit(1);
    }
    std::_Exit(0);
}

TEST(TerminationSignalsDeathTest, RunLoopWithoutDescriptorsSaysSo)
{
    EXPECT_EXIT(
        startWithoutDescriptors(), testing::ExitedWithCode(1), "the run loop gets no descriptors: Too many open files");
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
