#include "Telephony/Simulator/RRCConnection.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

/// Advances until the mode is there, and returns how long that took.
std::chrono::milliseconds until(RRCConnection& connection, RRCMode mode, bool isNeeded)
{
    std::chrono::milliseconds elapsed {0};
    while (connection.mode() != mode && elapsed < 1min) {
        connection.advance(100ms, isNeeded);
        elapsed += 100ms;
    }
    return elapsed;
}

TEST(RRCConnectionTest, IsSetUpAndSteppedDown)
{
    RRCConnection connection;
    EXPECT_EQ(until(connection, RRCMode::Connecting, true), 100ms);
    EXPECT_EQ(until(connection, RRCMode::CellDCH, true), 900ms);
    connection.advance(1min, true);
    EXPECT_TRUE(connection.isOnDedicatedChannel()) << "for as long as it is needed";
    EXPECT_EQ(until(connection, RRCMode::CellFACH, false), 3s);
    EXPECT_EQ(until(connection, RRCMode::CellPCH, false), 5s);
    EXPECT_EQ(until(connection, RRCMode::URAPCH, false), 8s);
    EXPECT_EQ(until(connection, RRCMode::Disconnected, false), 10s);
}

TEST(RRCConnectionTest, ComesBackFromPagingThroughTheCommonChannel)
{
    RRCConnection connection;
    until(connection, RRCMode::CellDCH, true);
    until(connection, RRCMode::URAPCH, false);
    EXPECT_EQ(until(connection, RRCMode::CellFACH, true), 100ms);
    EXPECT_EQ(until(connection, RRCMode::CellDCH, true), 500ms);
}

TEST(RRCConnectionTest, LosesItsCellAtOnce)
{
    RRCConnection connection;
    until(connection, RRCMode::CellDCH, true);
    connection.lose();
    EXPECT_EQ(connection.mode(), RRCMode::Disconnected);
}

} // namespace
} // namespace spectrel
