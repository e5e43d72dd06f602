#include "Telephony/Simulator/GSMUMTS/GSMUMTSWorld.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <set>
#include <string>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr int FiveMinutes = 3000; // steps
constexpr int TwoLaps = 7200; // at the least speed of 6 m/s the ring of 4 km takes 11 minutes, on average 5

template <typename Look> void drive(GSMUMTSWorld& world, int steps, Look look)
{
    for (int step = 0; step < steps; ++step) {
        world.advance(100ms);
        look();
        if (testing::Test::HasFailure())
            return;
    }
}

/// The changes of a state along some drives, each with a drive it happened in.
template <typename State> class Transitions {
public:
    void see(State from, State to)
    {
        if (from != to)
            _seen.insert({from, to});
    }
    void expectWithin(const std::map<State, std::set<State>>& legal) const
    {
        for (const auto& [from, to] : _seen)
            EXPECT_TRUE(legal.contains(from) && legal.at(from).contains(to))
                << "from " << static_cast<int>(from) << " to " << static_cast<int>(to);
    }
    bool contains(State from, State to) const
    {
        return _seen.contains({from, to});
    }

private:
    std::set<std::pair<State, State>> _seen;
};

std::string story(std::uint32_t seed)
{
    GSMUMTSWorld world(Scene::Drive, seed);
    std::string text;
    drive(world, FiveMinutes, [&] {
        const Situation& now = world.now();
        text += std::to_string(now.umtsCell ? now.umtsCell->identity
                        : now.gsmCell       ? now.gsmCell->identity
                                            : 0)
            + " " + std::to_string(world.bytesReceived()) + "\n";
    });
    return text;
}

TEST(GSMUMTSWorldTest, SameSeedGivesTheSameDrive)
{
    EXPECT_EQ(story(7), story(7));
    EXPECT_NE(story(7), story(8));
}

TEST(GSMUMTSWorldTest, EveryLapLeadsToGSMAndBack)
{
    for (std::uint32_t seed = 1; seed <= 5; ++seed) {
        GSMUMTSWorld world(Scene::Drive, seed);
        int left = 0;
        int returned = 0;
        drive(world, TwoLaps, [&] {
            left += world.before().system == RadioSystem::UMTS && world.system() == RadioSystem::GSM;
            returned += world.before().system == RadioSystem::GSM && world.system() == RadioSystem::UMTS;
        });
        EXPECT_GE(left, 1) << "seed " << seed;
        EXPECT_GE(returned, 1) << "seed " << seed;
        EXPECT_LE(left, 6) << "seed " << seed << ": to and fro at the valley's edge";
    }
}

TEST(GSMUMTSWorldTest, PhoneLeavesUMTSOnlyWhereItIsWeakAndReturnsWhereItIsGood)
{
    for (std::uint32_t seed = 1; seed <= 3; ++seed) {
        GSMUMTSWorld world(Scene::Drive, seed);
        drive(world, TwoLaps, [&] {
            if (world.before().system == RadioSystem::UMTS && world.system() == RadioSystem::GSM) {
                EXPECT_LT(world.before().umtsCell->ecno, -13) << "seed " << seed;
            }
            if (world.before().system == RadioSystem::GSM && world.system() == RadioSystem::UMTS) {
                EXPECT_GT(world.umts().servingCell().ecno, -14) << "seed " << seed;
            }
        });
    }
}

TEST(GSMUMTSWorldTest, StrongestCellOfTheActiveSetServes)
{
    std::set<std::size_t> sizes;
    for (std::uint32_t seed = 1; seed <= 5; ++seed) {
        GSMUMTSWorld world(Scene::Drive, seed);
        drive(world, FiveMinutes, [&] {
            const auto active = world.umts().activeSet();
            sizes.insert(active.size());
            if (world.umts().isOn()) {
                EXPECT_EQ(active.at(0), &world.umts().servingCell());
            }
            if (world.umts().state() != RRCState::CellDCH) {
                EXPECT_LE(active.size(), 1u) << "only a connection of its own is soft";
            }
        });
    }
    EXPECT_EQ(sizes, (std::set<std::size_t> {0, 1, 2, 3}));
}

TEST(GSMUMTSWorldTest, CellSetsNameTheActiveCellsFirstAndEachCellOnce)
{
    GSMUMTSWorld world(Scene::Drive, 3);
    drive(world, FiveMinutes, [&] {
        const auto cells = world.umts().cellSets().cells;
        const auto active = world.umts().activeSet();
        ASSERT_GE(cells.size(), active.size());
        std::set<std::uint16_t> codes;
        for (std::size_t cell = 0; cell < cells.size(); ++cell) {
            EXPECT_EQ(cells[cell].set == CellSet::Active, cell < active.size());
            codes.insert(cells[cell].scramblingCode);
        }
        EXPECT_EQ(codes.size(), cells.size());
    });
}

TEST(GSMUMTSWorldTest, LevelsAgree)
{
    Dice dice(4);
    GSMUMTSRoad road(Scene::Drive, dice);
    for (int step = 0; step < FiveMinutes; ++step) {
        road.advance(100ms, dice);
        double sum = 0;
        for (const UMTSCell& cell : road.umts()) {
            ASSERT_DOUBLE_EQ(cell.ecno, cell.rscp - road.carrierRssi());
            ASSERT_LE(cell.rscp, -25);
            sum += std::pow(10, cell.rscp / 10);
        }
        ASSERT_LT(10 * std::log10(sum), road.carrierRssi()) << "all pilots together are a part of the carrier";
        for (const GSMCell& cell : road.gsm())
            ASSERT_LE(cell.rssi, -40);
    }
}

TEST(GSMUMTSWorldTest, CellsCanBeToldApart)
{
    Dice dice(5);
    const GSMUMTSRoad road(Scene::Drive, dice);
    std::set<std::uint32_t> identities;
    std::set<std::uint16_t> codes;
    for (const UMTSCell& cell : road.umts()) {
        identities.insert(cell.identity);
        codes.insert(cell.scramblingCode);
        EXPECT_LT(cell.scramblingCode, 512);
        EXPECT_EQ(cell.uplinkChannel, cell.downlinkChannel - 950);
    }
    EXPECT_EQ(identities.size(), road.umts().size());
    EXPECT_EQ(codes.size(), road.umts().size());
    std::set<std::uint16_t> arfcns;
    for (const GSMCell& cell : road.gsm()) {
        arfcns.insert(cell.arfcn);
        for (const std::uint16_t hop : cell.hopping.arfcns)
            EXPECT_EQ(hop > 124, cell.arfcn > 124) << "hopping stays within the band";
        EXPECT_LT(cell.bsic, 64);
    }
    EXPECT_EQ(arfcns.size(), road.gsm().size());
}

TEST(GSMUMTSWorldTest, RRCStatesFollowEachOtherLegally)
{
    using enum RRCState;
    Transitions<RRCState> seen;
    for (std::uint32_t seed = 1; seed <= 10; ++seed) {
        GSMUMTSWorld world(Scene::Drive, seed);
        drive(world, FiveMinutes, [&] {
            if (world.before().rrc == Disconnected && world.now().rrc == CellDCH) {
                EXPECT_EQ(world.before().rr.state, RRState::ToUMTSByHandover);
            }
            seen.see(world.before().rrc, world.now().rrc);
        });
    }
    seen.expectWithin({{Disconnected, {Connecting, CellDCH}}, {Connecting, {CellDCH, CellFACH, Disconnected}},
        {CellDCH, {CellFACH, Disconnected}}, {CellFACH, {CellDCH, CellPCH, URAPCH, Disconnected}},
        {CellPCH, {CellFACH, Disconnected}}, {URAPCH, {CellFACH, Disconnected}}});
    EXPECT_TRUE(seen.contains(CellFACH, CellPCH));
    EXPECT_TRUE(seen.contains(CellFACH, URAPCH));
}

TEST(GSMUMTSWorldTest, RRStatesFollowEachOtherLegally)
{
    using enum RRState;
    Transitions<RRState> seen;
    for (std::uint32_t seed = 1; seed <= 20; ++seed) {
        GSMUMTSWorld world(Scene::Drive, seed);
        drive(world, FiveMinutes, [&] { seen.see(world.before().rr.state, world.now().rr.state); });
    }
    seen.expectWithin({{Inactive, {PLMNListConstruction, FromUMTSByHandover, FromUMTSByReselection, FromUMTSByOrder}},
        {PLMNListConstruction, {CellSelection}}, {CellSelection, {Idle}},
        {Idle, {ConnectionPending, CellReselection, ToUMTSByReselection}}, {CellReselection, {Idle}},
        {ConnectionPending, {DataTransfer, Idle}},
        {DataTransfer, {ConnectionRelease, CellReselection, ToUMTSByReselection, ToUMTSByHandover}},
        {ConnectionRelease, {Idle}}, {FromUMTSByHandover, {DataTransfer}}, {FromUMTSByReselection, {Idle}},
        {FromUMTSByOrder, {Idle}}, {ToUMTSByReselection, {Inactive}}, {ToUMTSByHandover, {Inactive}}});
    for (const RRState way : {PLMNListConstruction, FromUMTSByHandover, FromUMTSByReselection, FromUMTSByOrder})
        EXPECT_TRUE(seen.contains(Inactive, way)) << static_cast<int>(way);
    for (const RRState way : {ToUMTSByReselection, ToUMTSByHandover})
        EXPECT_TRUE(seen.contains(way, Inactive)) << static_cast<int>(way);
}

TEST(GSMUMTSWorldTest, MobilityFollowsTheMovement)
{
    GSMUMTSWorld world(Scene::Drive, 3);
    std::set<std::uint16_t> areas;
    int unregistered = 0; // steps in a row
    drive(world, TwoLaps, [&] {
        areas.insert(world.mobility().knownLocation().locationArea);
        const bool isUpToDate = world.mobility().knownLocation().locationArea == world.now().network.locationArea;
        unregistered = isUpToDate || world.mobility().isCalling() ? 0 : unregistered + 1;
        EXPECT_LT(unregistered, 150) << "an update takes seconds, a call may be in the way";
        if (world.now().mm.subState == MMSubState::NormalService) {
            EXPECT_TRUE(isUpToDate);
        }
    });
    EXPECT_EQ(areas, (std::set<std::uint16_t> {1201, 1202, 1211, 0xFFFE}));
}

TEST(GSMUMTSWorldTest, QualityIsOfTheConnectionThatThereIs)
{
    bool hasLostBlocks = false;
    for (std::uint32_t seed = 1; seed <= 5; ++seed) {
        GSMUMTSWorld world(Scene::Drive, seed);
        drive(world, FiveMinutes, [&] {
            const bool isOnDCH = world.umts().state() == RRCState::CellDCH;
            EXPECT_EQ(world.traffic().blocks().channels.empty(), !isOnDCH);
            for (const TransportChannelBlocks& channel : world.traffic().blocks().channels) {
                EXPECT_LE(channel.wrong, channel.received);
                hasLostBlocks = hasLostBlocks || channel.wrong > 0;
            }
            EXPECT_LE(world.traffic().hsdpa().subFrames, 500);
            for (const HARQProcess& process : world.traffic().hsdpa().primary)
                EXPECT_LE(process.blockErrors, process.newTransmissions);
            EXPECT_EQ(world.traffic().hsdpa().secondary.empty(),
                world.traffic().hsdpa().primary.empty() || world.traffic().hsdpa().carriers == HSDPACarriers::Single);
        });
    }
    EXPECT_TRUE(hasLostBlocks);
}

TEST(GSMUMTSWorldTest, UplinkPowerGrowsWithThePathLoss)
{
    GSMUMTSWorld world(Scene::Drive, 2);
    drive(world, FiveMinutes, [&] {
        if (!world.now().isSending)
            return;
        const double loss = world.umts().servingCell().power - world.umts().servingCell().rscp;
        const auto& last = world.traffic().powers().back();
        if (last && *last > -50 && *last < 24) {
            EXPECT_NEAR(*last, loss - 108, 1.001);
        }
    });
}

TEST(GSMUMTSWorldTest, TransferOnlyGrowsAndOnlyInASession)
{
    GSMUMTSWorld world(Scene::Drive, 3);
    std::uint64_t received = 0;
    drive(world, FiveMinutes, [&] {
        if (world.now().hasSession) {
            EXPECT_GE(world.bytesReceived(), received);
        } else {
            EXPECT_EQ(world.bytesReceived(), received);
        }
        received = world.bytesReceived();
    });
    EXPECT_GT(received, 1'000'000u);
}

TEST(GSMUMTSWorldTest, PhoneThatStandsStillKeepsItsSystem)
{
    GSMUMTSWorld world(Scene::Still, 3);
    drive(world, 100, [] {});
    const RadioSystem system = world.system();
    EXPECT_NE(system, RadioSystem::None);
    drive(world, FiveMinutes, [&] { EXPECT_EQ(world.system(), system); });
}

TEST(GSMUMTSWorldTest, NeighboursAreRankedBestFirst)
{
    GSMUMTSWorld world(Scene::Drive, 6);
    drive(world, FiveMinutes, [&] {
        const auto byRank = [](const auto& a, const auto& b) { return a.rank > b.rank; };
        const RankingReport ranking = world.ranking();
        EXPECT_TRUE(std::ranges::is_sorted(ranking.umts, byRank));
        EXPECT_TRUE(std::ranges::is_sorted(ranking.gsm, byRank));
        EXPECT_TRUE(ranking.gsm.empty() || world.measuresGSM());
    });
}

} // namespace
} // namespace spectrel
