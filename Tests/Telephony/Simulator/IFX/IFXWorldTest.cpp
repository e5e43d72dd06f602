#include "Telephony/Simulator/IFX/IFXWorld.h"

#include <gtest/gtest.h>
#include <set>
#include <string>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr int FiveMinutes = 3000; // steps

std::string diary(std::uint32_t seed)
{
    IFXWorld world(Scene::Drive, seed);
    std::string text;
    for (int step = 0; step < 300; ++step) {
        world.advance(100ms);
        text += std::to_string(world.serving().level) + " " + std::to_string(world.bytesReceived()) + "\n";
    }
    return text;
}

TEST(IFXWorldTest, SameSeedGivesTheSameDrive)
{
    EXPECT_EQ(diary(7), diary(7));
    EXPECT_NE(diary(7), diary(8));
}

TEST(IFXWorldTest, DriveChangesCellsAndMakesCalls)
{
    IFXWorld world(Scene::Drive, 1);
    std::set<std::uint16_t> cells;
    int talking = 0;
    for (int step = 0; step < FiveMinutes; ++step) {
        world.advance(100ms);
        cells.insert(world.serving().identity);
        talking += world.isTalking();
        EXPECT_LE(world.quality(), 7u);
        EXPECT_LE(world.timingAdvance(), 63u);
        const auto neighbours = world.neighbours();
        for (std::size_t index = 1; index < neighbours.size(); ++index)
            EXPECT_GE(neighbours[index - 1].level, neighbours[index].level);
    }
    EXPECT_GE(cells.size(), 4u);
    EXPECT_GE(world.cellsVisited(), cells.size());
    EXPECT_GT(talking, 1000);
    EXPECT_GT(world.bytesReceived(), 1'000'000u);
}

} // namespace
} // namespace spectrel
