#include "Telephony/Simulator/Move.h"

#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/LTE/LTEWorld.h"

#include <array>
#include <gtest/gtest.h>
#include <map>
#include <string>
#include <vector>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

constexpr std::array<Technology, 5> Technologies {
    Technology::LTE, Technology::GSM, Technology::UTRAN, Technology::CDMA, Technology::IFX};

std::vector<Move> movesOf(Technology technology, std::uint32_t seed, std::chrono::milliseconds time)
{
    const auto baseband = makeBaseband(technology, Scene::Drive, seed);
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
        for (const Move& move : movesOf(technology, 7, 20min)) {
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
        for (const Move& move : movesOf(technology, 7, 20min)) {
            if (move.cause)
                ++counts[move.cause->kind];
        }
        EXPECT_GT(counts[MoveKind::Reselection], 5U);
        EXPECT_GT(counts[MoveKind::Handover], 5U);
    }
}

TEST(MoveTest, ReselectionsAloneHaveARule)
{
    for (const Technology technology : Technologies) {
        SCOPED_TRACE(technologyName(technology));
        for (const Move& move : movesOf(technology, 3, 20min)) {
            if (move.cause) {
                EXPECT_EQ(move.cause->kind == MoveKind::Reselection, move.cause->rule != ReselectionRule::None);
            }
        }
    }
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
