#include "Telephony/Simulator/LTE/LTEWorld.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <gtest/gtest.h>
#include <set>
#include <string>
#include <vector>

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

TEST(LTEWorldTest, CellsAgreeWithTheirCarriers)
{
    const LTEWorld world(Scene::Drive, 3);
    std::set<std::uint32_t> identities;
    for (const LTECell& cell : world.road().cells()) {
        EXPECT_LT(cell.physicalCellId, 504);
        ASSERT_TRUE(cell.layer);
        EXPECT_EQ(cell.band, cell.layer->band);
        EXPECT_EQ(cell.downlinkChannel, cell.layer->downlinkChannel);
        EXPECT_EQ(cell.uplinkChannel, cell.downlinkChannel + 18000);
        EXPECT_EQ(cell.resourceBlocks, cell.layer->resourceBlocks);
        EXPECT_TRUE(identities.insert(cell.identity).second) << "an identity of its own";
    }
}

TEST(LTEWorldTest, NeighboursAreTheStrongestOtherCells)
{
    LTEWorld world(Scene::Drive, 3);
    for (int step = 0; step < 3000; ++step) {
        world.advance(100ms);
        std::vector<double> levels; // of the other cells
        for (const LTECell& cell : world.road().cells()) {
            if (&cell != &world.servingCell())
                levels.push_back(cell.average.rsrp);
        }
        std::ranges::sort(levels, std::ranges::greater());
        const auto neighbours = world.neighbours(3);
        ASSERT_EQ(neighbours.size(), 3u);
        for (std::size_t index = 0; index < neighbours.size(); ++index) {
            EXPECT_NE(neighbours[index], &world.servingCell());
            EXPECT_EQ(neighbours[index]->average.rsrp, levels[index]);
        }
    }
}

TEST(LTEWorldTest, LevelsAgree)
{
    LTEWorld world(Scene::Drive, 3);
    for (int step = 0; step < 3000; ++step) {
        world.advance(100ms);
        for (const LTECell& cell : world.road().cells()) {
            for (const LTELevels& levels : {cell.measured, cell.average}) {
                EXPECT_GE(levels.rsrp, -140);
                EXPECT_LE(levels.rsrp, -44);
                EXPECT_NEAR(levels.rsrq, 10 * std::log10(cell.resourceBlocks) + levels.rsrp - levels.rssi, 1e-9);
                EXPECT_LE(levels.rsrq, -3) << "a cell cannot send more in its reference symbols than in all";
            }
        }
    }
}

TEST(LTEWorldTest, CellsOfACarrierShareItsRSSI)
{
    LTEWorld world(Scene::Drive, 3);
    world.advance(100ms);
    for (const LTECell& one : world.road().cells()) {
        for (const LTECell& other : world.road().cells()) {
            if (one.layer == other.layer) {
                EXPECT_EQ(one.measured.rssi, other.measured.rssi);
            }
        }
    }
}

/// How much stronger one cell is than another, in dB.
double ahead(const LTEWorld& world, std::size_t cell, std::size_t of)
{
    return world.road().cells()[cell].average.rsrp - world.road().cells()[of].average.rsrp;
}

std::size_t servingIndex(const LTEWorld& world)
{
    return static_cast<std::size_t>(&world.servingCell() - world.road().cells().data());
}

TEST(LTEWorldTest, NextCellRisesAsTheServingCellFalls)
{
    // The same drive twice, one 10 s ahead of the other.
    LTEWorld now(Scene::Drive, 3);
    LTEWorld before(Scene::Drive, 3);
    for (int step = 0; step < 100; ++step)
        now.advance(100ms);
    int changes = 0;
    for (int step = 0; step < 6000; ++step) {
        const std::size_t previous = servingIndex(now);
        now.advance(100ms);
        before.advance(100ms);
        const std::size_t next = servingIndex(now);
        const auto& cells = now.road().cells();
        if (next == previous || cells[next].layer != cells[previous].layer)
            continue;
        ++changes;
        EXPECT_GE(ahead(now, next, previous), 0);
        EXPECT_LT(ahead(before, next, previous), ahead(now, next, previous));
    }
    EXPECT_GE(changes, 5);
}

/// Whether idle mode may have moved from one cell to the other now (3GPP TS 36.304, 5.2.4.5 and 5.2.4.6).
bool mayMove(const LTECell& from, const LTECell& to)
{
    const auto level = [](const LTECell& cell) { return std::floor(cell.average.rsrp) - cell.layer->qRxLevMin; };
    if (to.layer->priority > from.layer->priority)
        return level(to) > to.layer->threshHigh;
    if (to.layer == from.layer)
        return level(to) > 0 && to.average.rsrp > from.average.rsrp + 4;
    return level(from) < from.layer->threshServingLow && level(to) > to.layer->threshLow;
}

TEST(LTEWorldTest, IdlePhoneMovesByTheCriteriaOnly)
{
    int moves = 0;
    for (std::uint32_t seed = 1; seed <= 4; ++seed) {
        LTEWorld world(Scene::Drive, seed);
        for (int step = 0; step < 6000; ++step) {
            const LTECell& previous = world.servingCell();
            const bool wasIdle = !world.isConnected();
            const unsigned cyclesBelowZero = world.idleMode().serving().cyclesBelowZero;
            world.advance(100ms);
            if (&world.servingCell() == &previous || !wasIdle || world.isConnected())
                continue;
            ++moves;
            const bool isLost = cyclesBelowZero + 1 >= LTEIdleMode::CyclesUntilLost && world.servingCell().srxlev() > 0;
            EXPECT_TRUE(isLost || mayMove(previous, world.servingCell())) << seed << " " << step;
        }
    }
    EXPECT_GE(moves, 20);
}

TEST(LTEWorldTest, RulesFollowTheThresholds)
{
    LTEWorld world(Scene::Drive, 5);
    std::set<int> rules;
    for (int step = 0; step < 6000; ++step) {
        world.advance(100ms);
        const LTEServingReport& report = world.idleMode().serving();
        const bool intra = !report.sIntraSearch || report.srxlev <= *report.sIntraSearch;
        const bool lower = !report.sNonIntraSearch || report.srxlev <= *report.sNonIntraSearch;
        EXPECT_EQ(report.rules & 3, (intra ? 1 : 0) | (lower ? 2 : 0));
        EXPECT_EQ(report.rules & 4, report.priority < 6 ? 4 : 0);
        EXPECT_EQ(report.srxlev, std::floor(report.average.rsrp) - report.qRxLevMin);
        EXPECT_EQ(report.cyclesBelowZero > 0, report.srxlev < 0);
        rules.insert(report.rules);
    }
    EXPECT_GE(rules.size(), 4u);
}

TEST(LTEWorldTest, CandidatesAreOfEveryTechnology)
{
    std::set<ReselectionTechnology> technologies;
    for (std::uint32_t seed = 1; seed <= 4; ++seed) {
        LTEWorld world(Scene::Drive, seed);
        for (int step = 0; step < 6000; ++step) {
            world.advance(100ms);
            for (const ReselectionCandidate& candidate : world.idleMode().candidate().candidates)
                technologies.insert(candidate.technology);
        }
    }
    EXPECT_EQ(technologies.size(), 5u);
}

TEST(LTEWorldTest, ConnectionFollowsTheStrongerCellAndIdleTimesAlternate)
{
    LTEWorld world(Scene::Drive, 2);
    int connected = 0;
    int changes = 0;
    for (int step = 0; step < 3000; ++step) {
        const bool was = world.isConnected();
        world.advance(100ms);
        connected += world.isConnected() ? 1 : 0;
        changes += world.isConnected() != was ? 1 : 0;
    }
    EXPECT_GT(connected, 600);
    EXPECT_LT(connected, 2700);
    EXPECT_GE(changes, 6);
}

TEST(LTEWorldTest, ConnectedReportHoldsTheServingCarrierOnly)
{
    LTEWorld world(Scene::Drive, 2);
    int measured = 0;
    int detected = 0;
    for (int step = 0; step < 3000; ++step) {
        world.advance(100ms);
        const LTEConnectedReport report = world.connectedReport();
        EXPECT_EQ(report.channel, world.servingCell().downlinkChannel);
        EXPECT_LT(report.subframe, 10);
        for (const LTEConnectedNeighbour& neighbour : report.measured)
            EXPECT_GE(neighbour.filtered.rsrq, -19);
        measured += static_cast<int>(report.measured.size());
        detected += static_cast<int>(report.detected.size());
    }
    EXPECT_GT(measured, 500);
    EXPECT_GT(detected, 100);
}

TEST(LTEWorldTest, PhoneThatStaysStillKeepsItsPlace)
{
    LTEWorld world(Scene::Still, 1);
    std::set<std::uint32_t> sites;
    for (int step = 0; step < 3000; ++step) {
        world.advance(100ms);
        sites.insert(world.servingCell().identity >> 8);
    }
    EXPECT_LE(sites.size(), 2u);
}

TEST(LTEWorldTest, TransferGrowsInConnectionsOnly)
{
    LTEWorld world(Scene::Drive, 2);
    std::uint64_t received = 0;
    for (int step = 0; step < 600; ++step) {
        world.advance(100ms);
        EXPECT_EQ(world.bytesReceived() > received, world.isConnected());
        received = world.bytesReceived();
    }
    EXPECT_GT(received, 0u);
}

} // namespace
} // namespace spectrel
