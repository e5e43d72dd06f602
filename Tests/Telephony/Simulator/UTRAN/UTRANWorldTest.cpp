#include "Telephony/Simulator/UTRAN/UTRANWorld.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <set>
#include <string>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr int Drive = 6000; // steps, ten minutes

std::string drive(Scene scene, std::uint32_t seed)
{
    UTRANWorld world(scene, seed);
    std::string text;
    for (int step = 0; step < 1200; ++step) {
        world.advance(100ms);
        text += std::to_string(world.servingCell().rscp) + " " + std::to_string(world.bytesReceived()) + "\n";
    }
    return text;
}

TEST(UTRANWorldTest, SameSeedGivesTheSameDrive)
{
    EXPECT_EQ(drive(Scene::Drive, 7), drive(Scene::Drive, 7));
    EXPECT_NE(drive(Scene::Drive, 7), drive(Scene::Drive, 8));
    EXPECT_NE(drive(Scene::Drive, 7), drive(Scene::Still, 7));
}

TEST(UTRANWorldTest, ConnectionPassesThroughEveryMode)
{
    UTRANWorld world(Scene::Drive, 1);
    std::set<RRCMode> modes;
    for (int step = 0; step < Drive; ++step) {
        world.advance(100ms);
        modes.insert(world.mode());
    }
    EXPECT_EQ(modes.size(), 6u);
}

TEST(UTRANWorldTest, PhoneMovesByTheRankingOnly)
{
    UTRANWorld world(Scene::Drive, 2);
    int moves = 0;
    for (int step = 0; step < Drive; ++step) {
        const UTRANCell& previous = world.servingCell();
        const RRCMode mode = world.mode();
        world.advance(100ms);
        if (&world.servingCell() == &previous)
            continue;
        ++moves;
        EXPECT_GT(world.servingCell().rscp, previous.rscp + UTRANThresholds::QHyst1s);
        EXPECT_GT(world.servingCell().rscp, UTRANThresholds::QRxLevMin);
        if (mode != RRCMode::CellDCH && world.servingCell().channel != previous.channel) {
            EXPECT_LE(previous.rscp - UTRANThresholds::QRxLevMin, UTRANThresholds::SInterSearch);
        }
    }
    EXPECT_GE(moves, 10);
}

/// The reported cells beside the serving one.
std::vector<UTRANNeighbour> others(const UTRANWorld& world)
{
    auto reported = world.neighbours();
    std::erase_if(reported, [](const UTRANNeighbour& cell) { return cell.set == UTRANCellSet::Active; });
    return reported;
}

bool hasOtherChannel(const UTRANWorld& world)
{
    return std::ranges::any_of(
        others(world), [&world](const UTRANNeighbour& cell) { return cell.channel != world.servingCell().channel; });
}

TEST(UTRANWorldTest, IdlePhoneMeasuresItsOwnChannelUnderTheMastToo)
{
    UTRANWorld world(Scene::Drive, 1);
    int near = 0;
    int withNeighbours = 0;
    for (int step = 0; step < Drive; ++step) {
        world.advance(100ms);
        if (world.mode() == RRCMode::CellDCH || world.srxlev() <= UTRANThresholds::SInterSearch)
            continue;
        ++near;
        withNeighbours += others(world).empty() ? 0 : 1;
        EXPECT_FALSE(hasOtherChannel(world)) << "those wait until the serving cell has fallen";
    }
    EXPECT_GT(near, 100);
    EXPECT_GT(withNeighbours, near / 2);
}

TEST(UTRANWorldTest, OtherChannelsAreMeasuredOnceTheServingCellHasFallenOrOnADedicatedChannel)
{
    UTRANWorld world(Scene::Drive, 1);
    int fallen = 0;
    int dedicated = 0;
    for (int step = 0; step < Drive; ++step) {
        world.advance(100ms);
        if (!hasOtherChannel(world))
            continue;
        const bool hasFallen = world.srxlev() <= UTRANThresholds::SInterSearch;
        fallen += hasFallen && world.mode() != RRCMode::CellDCH ? 1 : 0;
        dedicated += !hasFallen ? 1 : 0;
        EXPECT_TRUE(hasFallen || world.mode() == RRCMode::CellDCH);
    }
    EXPECT_GT(fallen, 100);
    EXPECT_GT(dedicated, 100);
}

TEST(UTRANWorldTest, CellsAreDetectedOnTheOwnChannelOfADedicatedOneOnly)
{
    UTRANWorld world(Scene::Drive, 1);
    int detected = 0;
    for (int step = 0; step < Drive; ++step) {
        world.advance(100ms);
        for (const UTRANNeighbour& cell : world.neighbours()) {
            if (cell.set != UTRANCellSet::Detected)
                continue;
            ++detected;
            EXPECT_EQ(world.mode(), RRCMode::CellDCH);
            EXPECT_EQ(cell.channel, world.servingCell().channel);
        }
    }
    EXPECT_GT(detected, 100);
}

TEST(UTRANWorldTest, ServingCellIsTheActiveSetOfADedicatedChannel)
{
    UTRANWorld world(Scene::Drive, 1);
    for (int step = 0; step < Drive; ++step) {
        world.advance(100ms);
        const auto neighbours = world.neighbours();
        const auto active = std::ranges::find(neighbours, UTRANCellSet::Active, &UTRANNeighbour::set);
        ASSERT_EQ(active != neighbours.end(), world.mode() == RRCMode::CellDCH);
        if (active != neighbours.end()) {
            EXPECT_EQ(active->cellParameterId, world.servingCell().cellParameterId);
        }
    }
}

TEST(UTRANWorldTest, TransportChannelsBelongToDedicatedChannels)
{
    UTRANWorld world(Scene::Drive, 1);
    int weak = 0;
    for (int step = 0; step < Drive; ++step) {
        world.advance(100ms);
        const TransportReport report = world.transportChannels();
        ASSERT_EQ(report.channels.empty(), world.mode() != RRCMode::CellDCH);
        ASSERT_EQ(report.composites.empty(), report.channels.empty());
        for (const CodedCompositeChannel& composite : report.composites) {
            for (std::size_t slot = composite.slots; slot < composite.signalToInterference.size(); ++slot)
                EXPECT_EQ(composite.signalToInterference[slot], 0);
        }
        for (const TransportChannel& channel : report.channels) {
            EXPECT_LE(channel.blockErrors, 100);
            weak += channel.blockErrors > 5 ? 1 : 0;
        }
    }
    EXPECT_GT(weak, 0) << "somewhere the signal gets weak";
}

TEST(UTRANWorldTest, InTheValleyOnlyHelpCanBeCalled)
{
    UTRANWorld world(Scene::Drive, 1);
    int without = 0;
    for (int step = 0; step < Drive; ++step) {
        world.advance(100ms);
        if (world.isInService())
            continue;
        ++without;
        EXPECT_EQ(world.mode(), RRCMode::Disconnected);
        EXPECT_LE(world.servingCell().rscp, UTRANThresholds::QRxLevMin);
    }
    EXPECT_GT(without, 10);
    EXPECT_LT(without, Drive / 4);
}

TEST(UTRANWorldTest, GSMCellsAreReportedStrongestFirst)
{
    UTRANWorld world(Scene::Walk, 1);
    world.advance(100ms);
    const auto cells = world.gsmNeighbours();
    ASSERT_FALSE(cells.empty());
    EXPECT_TRUE(std::ranges::is_sorted(cells, std::ranges::greater(), &GSMNeighbour::rssi));
    for (const GSMNeighbour& cell : cells) {
        EXPECT_LT(cell.identity, 0x4000);
        EXPECT_LT(cell.networkColour, 8);
        EXPECT_LT(cell.stationColour, 8);
    }
}

} // namespace
} // namespace spectrel
