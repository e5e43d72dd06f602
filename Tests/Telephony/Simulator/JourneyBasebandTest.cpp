#include "Telephony/Simulator/JourneyBaseband.h"

#include "Records/Frame.h"

#include <gtest/gtest.h>
#include <map>
#include <set>
#include <utility>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

/// The radio technologies that a baseband's cells have.
std::set<std::string_view> radiosOf(Technology technology)
{
    if (technology == Technology::LTE)
        return {"lte"};
    return {technology == Technology::UTRAN ? "umts" : "gsm"};
}

TEST(JourneyBasebandTest, ItBeginsWithTheTechnologyAskedFor)
{
    for (const Technology technology : {Technology::LTE, Technology::UTRAN, Technology::GSM}) {
        const JourneyBaseband baseband(technology, 1);
        EXPECT_EQ(baseband.technology(), technology);
        ASSERT_EQ(baseband.moves().size(), 1U);
        EXPECT_FALSE(baseband.moves()[0].from);
        EXPECT_TRUE(radiosOf(technology).contains(baseband.moves()[0].to.technology));
    }
}

TEST(JourneyBasebandTest, ThePhoneMovesThroughAllThreeTechnologiesFromCellToCell)
{
    for (const std::uint32_t seed : {1U, 2U, 3U}) {
        JourneyBaseband baseband(Technology::LTE, seed);
        CellName serving = baseband.moves()[0].to;
        std::map<std::pair<Technology, Technology>, unsigned> changes;
        for (auto time = 0ms; time < 20min; time += Baseband::Step) {
            const Technology before = baseband.technology();
            baseband.advance(Moment(time), [](ByteView) {});
            for (const Move& move : baseband.moves()) {
                ASSERT_EQ(move.from, serving);
                serving = move.to;
            }
            EXPECT_TRUE(radiosOf(baseband.technology()).contains(serving.technology));
            if (baseband.technology() != before)
                ++changes[{before, baseband.technology()}];
        }
        EXPECT_TRUE(changes.contains({Technology::LTE, Technology::UTRAN}));
        EXPECT_TRUE(changes.contains({Technology::UTRAN, Technology::GSM}));
        EXPECT_TRUE(changes.contains({Technology::GSM, Technology::LTE}));
    }
}

TEST(JourneyBasebandTest, TechnologyOfHigherPriorityIsReselectedAndLowerOnesByTheirRules)
{
    JourneyBaseband baseband(Technology::LTE, 1);
    std::map<std::string_view, unsigned> rank {{"gsm", 0}, {"umts", 1}, {"lte", 2}};
    unsigned count = 0;
    for (auto time = 0ms; time < 60min; time += Baseband::Step) {
        baseband.advance(Moment(time), [](ByteView) {});
        for (const Move& move : baseband.moves()) {
            const auto from = rank[move.from->technology];
            const auto to = rank[move.to.technology];
            count += from != to;
            if (to > from) {
                EXPECT_EQ(*move.cause, byReselection(ReselectionRule::HigherPriority));
            }
            if (to < from && move.cause->kind == MoveKind::Reselection) {
                EXPECT_TRUE(move.cause->rule == ReselectionRule::LowerPriority
                    || move.cause->rule == ReselectionRule::NotSuitable);
            }
        }
    }
    EXPECT_GT(count, 15U);
}

TEST(JourneyBasebandTest, OnlyTheServingTechnologyReports)
{
    constexpr std::uint32_t LTEServingCell = 0xB0C2;
    constexpr std::uint32_t UTRANServingCell = 0xD0E2;
    JourneyBaseband baseband(Technology::LTE, 1);
    std::map<Technology, std::map<std::uint32_t, unsigned>> counts;
    for (auto time = 0ms; time < 20min; time += Baseband::Step) {
        const Technology before = baseband.technology();
        baseband.advance(Moment(time), [&](ByteView record) { ++counts[before][*routedCode(record)]; });
    }
    EXPECT_GT(counts[Technology::LTE][LTEServingCell], 100U);
    EXPECT_GT(counts[Technology::UTRAN][UTRANServingCell], 20U);
    EXPECT_EQ(counts[Technology::LTE][UTRANServingCell], 0U);
    EXPECT_EQ(counts[Technology::UTRAN][LTEServingCell], 0U);
    EXPECT_EQ(counts[Technology::GSM][LTEServingCell], 0U);
}

} // namespace
} // namespace spectrel
