#include "Telephony/Simulator/LTEWorld.h"

#include <gtest/gtest.h>
#include <set>
#include <string>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

std::string drive(std::uint32_t seed, int steps)
{
    LTEWorld world(Scene::Drive, seed);
    std::string text;
    for (int step = 0; step < steps; ++step) {
        world.advance(100ms);
        text += std::to_string(world.servingCell().identity) + " " + std::to_string(world.bytesReceived()) + "\n";
    }
    return text;
}

TEST(LTEWorldTest, SameSeedGivesTheSameDrive)
{
    EXPECT_EQ(drive(7, 600), drive(7, 600));
    EXPECT_NE(drive(7, 600), drive(8, 600));
}

TEST(LTEWorldTest, DrivePassesSeveralCells)
{
    LTEWorld world(Scene::Drive, 1);
    std::set<std::uint32_t> cells;
    for (int step = 0; step < 3000; ++step) {
        world.advance(100ms);
        cells.insert(world.servingCell().identity);
    }
    EXPECT_GE(cells.size(), 5u) << "in five minutes";
}

TEST(LTEWorldTest, ValuesBelongTogether)
{
    LTEWorld world(Scene::Drive, 3);
    for (int step = 0; step < 3000; ++step) {
        world.advance(100ms);
        const LTECell& cell = world.servingCell();
        EXPECT_LT(cell.physicalCellId, 504);
        EXPECT_EQ(cell.uplinkChannel, cell.downlinkChannel + 18000);
        EXPECT_GE(cell.rsrp, -140);
        EXPECT_LE(cell.rsrp, -44);
        const auto neighbours = world.neighbours(3);
        ASSERT_EQ(neighbours.size(), 3u);
        EXPECT_GE(neighbours[0]->rsrp, neighbours[1]->rsrp);
        EXPECT_LE(neighbours[0]->rsrp, cell.rsrp + 12) << "a much better cell would have taken over";
    }
}

TEST(LTEWorldTest, TransferOnlyGrows)
{
    LTEWorld world(Scene::Drive, 3);
    std::uint64_t received = 0;
    for (int step = 0; step < 100; ++step) {
        world.advance(100ms);
        EXPECT_GT(world.bytesReceived(), received);
        received = world.bytesReceived();
    }
}

} // namespace
} // namespace spectrel
