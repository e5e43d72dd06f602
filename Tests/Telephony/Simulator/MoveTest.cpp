#include "Telephony/Simulator/Move.h"

#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/LTE/LTEWorld.h"
#include "Telephony/Simulator/UTRAN/UTRANWorld.h"

#include <array>
#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <string>
#include <vector>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr std::array<Technology, 5> Technologies {
    Technology::LTE, Technology::GSM, Technology::UTRAN, Technology::CDMA, Technology::IFX};

std::vector<Move> movesOf(
    Technology technology, std::uint32_t seed, std::chrono::milliseconds time, Scene scene = Scene::Drive)
{
    const auto baseband = makeBaseband(technology, scene, seed);
    std::vector<Move> moves;
    const auto keep = [&] { moves.insert(moves.end(), baseband->moves().begin(), baseband->moves().end()); };
    keep();
    for (auto step = 0ms; step < time; step += Baseband::Step) {
        baseband->advance(Moment(), [](ByteView) {});
        keep();
    }
    return moves;
}

/// EV-DO moves beside 1x; the other technologies of a phone take turns.
std::string phoneOf(const Move& move)
{
    return move.to.technology == "evdo" ? "evdo" : "phone";
}

TEST(MoveTest, EachMoveStartsWhereThePreviousOneEnded)
{
    for (const Technology technology : Technologies) {
        SCOPED_TRACE(technologyName(technology));
        std::map<std::string, CellName> serving;
        for (const Move& move : movesOf(technology, 7, 10min)) {
            const bool isFirst = !serving.contains(phoneOf(move));
            ASSERT_EQ(isFirst, !move.from);
            ASSERT_EQ(isFirst, !move.cause);
            if (move.from) {
                EXPECT_EQ(*move.from, serving.at(phoneOf(move)));
                EXPECT_NE(*move.from, move.to);
            }
            serving[phoneOf(move)] = move.to;
        }
    }
}

TEST(MoveTest, EveryTechnologyMovesIdleAndConnected)
{
    for (const Technology technology : Technologies) {
        SCOPED_TRACE(technologyName(technology));
        std::map<MoveKind, unsigned> counts;
        for (const Move& move : movesOf(technology, 7, 10min)) {
            if (move.cause)
                ++counts[move.cause->kind];
        }
        EXPECT_GT(counts[MoveKind::Reselection], 2U);
        EXPECT_GT(counts[MoveKind::Handover], 2U);
    }
}

TEST(MoveTest, ReselectionsAloneHaveARule)
{
    for (const Technology technology : Technologies) {
        SCOPED_TRACE(technologyName(technology));
        for (const Move& move : movesOf(technology, 3, 10min)) {
            if (move.cause) {
                EXPECT_EQ(move.cause->kind == MoveKind::Reselection, move.cause->rule != ReselectionRule::None);
            }
        }
    }
}

std::map<MoveKind, unsigned> kindsOf(const std::vector<Move>& moves)
{
    std::map<MoveKind, unsigned> counts;
    for (const Move& move : moves) {
        if (move.cause)
            ++counts[move.cause->kind];
    }
    return counts;
}

TEST(MoveTest, HandoversPrevailInTheirScene)
{
    for (const Technology technology : Technologies) {
        SCOPED_TRACE(technologyName(technology));
        const auto counts = kindsOf(movesOf(technology, 1, 10min, Scene::Handover));
        const auto handovers = counts.contains(MoveKind::Handover) ? counts.at(MoveKind::Handover) : 0;
        const auto reselections = counts.contains(MoveKind::Reselection) ? counts.at(MoveKind::Reselection) : 0;
        EXPECT_GT(handovers, 5U);
        EXPECT_GT(handovers, 2 * reselections);
    }
}

TEST(MoveTest, TunnelsEndInAnotherCellAtTimes)
{
    for (const Technology technology : Technologies) {
        SCOPED_TRACE(technologyName(technology));
        unsigned lost = 0;
        for (const std::uint32_t seed : {1U, 2U, 3U})
            lost += kindsOf(movesOf(technology, seed, 10min, Scene::Tunnel))[MoveKind::ServiceLost];
        EXPECT_GT(lost, 0U);
    }
}

/// A to B and back to A.
unsigned returns(const std::vector<Move>& moves)
{
    unsigned count = 0;
    for (std::size_t index = 1; index < moves.size(); ++index)
        count += moves[index - 1].from && moves[index].to == *moves[index - 1].from;
    return count;
}

TEST(MoveTest, PhoneInPingPongGoesBackAndForth)
{
    for (const Technology technology : Technologies) {
        SCOPED_TRACE(technologyName(technology));
        unsigned here = 0;
        unsigned driving = 0;
        for (const std::uint32_t seed : {1U, 2U}) {
            here += returns(movesOf(technology, seed, 10min, Scene::PingPong));
            driving += returns(movesOf(technology, seed, 10min, Scene::Drive));
        }
        EXPECT_GT(here, 4U);
        EXPECT_GT(here, 2 * driving);
    }
}

/// For how long a cell serves that stands far from the next strongest one.
template <typename World, typename Strongest>
std::chrono::milliseconds servedFromAfar(Scene scene, double ringLength, const Strongest& strongest)
{
    constexpr double Far = 1200; // metres
    World world(scene, 2);
    std::chrono::milliseconds time {0};
    for (auto step = 0ms; step < 20min; step += Baseband::Step) {
        world.advance(Baseband::Step);
        const double apart = std::remainder(world.servingCell().position - strongest(world)->position, ringLength);
        if (std::fabs(apart) > Far)
            time += Baseband::Step;
    }
    return time;
}

TEST(MoveTest, FarCellServesWhereItOvershoots)
{
    // Where there are no sites, cells from afar serve on any drive.
    const auto lte = [](Scene scene) {
        return servedFromAfar<LTEWorld>(
            scene, LTERoad::Length, [](const LTEWorld& world) { return world.neighbours(1).front(); });
    };
    EXPECT_GT(lte(Scene::Overshoot), lte(Scene::Drive) + 20s);
    const auto utran = [](Scene scene) {
        return servedFromAfar<UTRANWorld>(
            scene, 5000, [](const UTRANWorld& world) { return world.otherCells().front(); });
    };
    EXPECT_GT(utran(Scene::Overshoot), utran(Scene::Drive) + 20s);
}

TEST(MoveTest, LTERuleAgreesWithTheCarriersPriorities)
{
    LTEWorld world(Scene::Drive, 5);
    std::map<ReselectionRule, unsigned> counts;
    const LTECell* previous = &world.servingCell();
    for (auto step = 0ms; step < 60min; step += Baseband::Step) {
        const bool wasConnected = world.isConnected();
        world.advance(Baseband::Step);
        for (const Move& move : world.moves()) {
            const int steps = world.servingCell().layer->priority - previous->layer->priority;
            ++counts[move.cause->rule];
            if (move.cause->rule == ReselectionRule::HigherPriority) {
                EXPECT_GT(steps, 0);
            }
            if (move.cause->rule == ReselectionRule::EqualPriority) {
                EXPECT_EQ(steps, 0);
            }
            if (move.cause->rule == ReselectionRule::LowerPriority) {
                EXPECT_LT(steps, 0);
            }
            if (move.cause->kind == MoveKind::Handover) {
                EXPECT_TRUE(wasConnected || world.isConnected());
            }
        }
        previous = &world.servingCell();
    }
    EXPECT_EQ(counts.size(), 5U) << "every rule, and handovers";
}

} // namespace
} // namespace spectrel
