#include "Analysis/Report/LevelTimeline.h"

#include "Tests/Analysis/Report/ReportSamples.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

TEST(LevelTimelineTest, ValuesStandInTheColumnOfTheirTime)
{
    LevelTimeline timeline;
    timeline.touch(ReportStart, 0);
    timeline.add(Level::RSRP, -90);
    timeline.touch(ReportStart + 100ms, 0);
    timeline.add(Level::RSRP, -100);
    timeline.touch(ReportStart + 600ms, 1);
    timeline.add(Level::RSRP, -95);
    ASSERT_EQ(timeline.columns().size(), 3u);
    EXPECT_EQ(timeline.columns()[0].level(Level::RSRP).mean(), -95);
    EXPECT_EQ(timeline.columns()[0].level(Level::RSRP).min, -100);
    EXPECT_EQ(timeline.columns()[0].level(Level::RSRP).max, -90);
    EXPECT_FALSE(timeline.columns()[1].isTouched);
    EXPECT_EQ(timeline.columns()[2].cell, 1u);
    EXPECT_EQ(timeline.columns()[2].level(Level::RSRQ).count, 0u);
}

TEST(LevelTimelineTest, ADayTakesNoMoreColumnsThanAMinute)
{
    LevelTimeline timeline;
    for (int second = 0; second < 86400; ++second) {
        timeline.touch(ReportStart + std::chrono::seconds(second), 0);
        timeline.add(Level::RSRP, second == 40000 ? -140 : -90);
    }
    EXPECT_LE(timeline.columns().size(), LevelTimeline::MaxColumns);
    EXPECT_GT(timeline.columns().size(), LevelTimeline::MaxColumns / 3);
    std::uint64_t values = 0;
    double min = 0;
    for (const LevelTimeline::Column& column : timeline.columns()) {
        values += column.level(Level::RSRP).count;
        min = std::min(min, column.level(Level::RSRP).min);
    }
    EXPECT_EQ(values, 86400u);
    EXPECT_EQ(min, -140) << "a short dip stays visible";
}

TEST(LevelTimelineTest, YearsBetweenTwoMessagesAreOneStep)
{
    LevelTimeline timeline;
    timeline.touch(ReportStart, 0);
    timeline.touch(ReportStart + 24h * 365 * 40, 1);
    EXPECT_LE(timeline.columns().size(), LevelTimeline::MaxColumns);
    EXPECT_EQ(timeline.columns().front().cell, 0u);
    EXPECT_EQ(timeline.columns().back().cell, 1u);
}

TEST(LevelTimelineTest, ATimeThatGoesBackStaysInTheLatestColumn)
{
    LevelTimeline timeline;
    timeline.touch(ReportStart + 10s, 0);
    timeline.touch(ReportStart, 1);
    EXPECT_EQ(timeline.columns().size(), 1u);
    EXPECT_EQ(timeline.columns().front().cell, 1u);
}

} // namespace
} // namespace spectrel
