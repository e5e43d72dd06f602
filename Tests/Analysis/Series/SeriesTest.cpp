#include "Analysis/Series/Series.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class SeriesTest : public testing::Test {
protected:
    /// A refresh, 2 s after the one before.
    void add(std::optional<double> value)
    {
        const int joins = axis.advance(Start + 2s * count++);
        series.add(axis, joins, value);
    }

    static constexpr Moment Start {std::chrono::seconds(1'700'000'000)};
    SeriesAxis axis;
    Series series;
    int count = 0;
};

TEST_F(SeriesTest, RecentValuesAreKeptOneByOne)
{
    add({});
    add(1.5);
    add({});
    add(-2);
    ASSERT_EQ(axis.recentCount(), 4u);
    EXPECT_EQ(axis.recentTime(1), Start + 2s);
    EXPECT_EQ(series.recent(axis, 0), std::nullopt);
    EXPECT_EQ(series.recent(axis, 1), 1.5);
    EXPECT_EQ(series.recent(axis, 2), std::nullopt);
    EXPECT_EQ(series.recent(axis, 3), -2.0);
    EXPECT_EQ(series.statistics().count(), 2u);
}

TEST_F(SeriesTest, OnlyTheLatestHalfHourIsKeptOneByOne)
{
    for (int value = 0; value < 1000; ++value)
        add(value);
    ASSERT_EQ(axis.recentCount(), 900u);
    EXPECT_EQ(axis.recentTime(0), Start + 200s);
    EXPECT_EQ(series.recent(axis, 0), 100.0);
    EXPECT_EQ(series.recent(axis, 899), 999.0);
}

TEST_F(SeriesTest, ShortCourseIsKeptInFull)
{
    for (int value = 0; value < 1440; ++value)
        add(value);
    EXPECT_EQ(axis.spanLength(), 2s);
    ASSERT_EQ(series.spans().size(), 1440u);
    EXPECT_EQ(series.spans()[700].mean, 700);
}

TEST_F(SeriesTest, LongCourseIsKeptInSpansThatDouble)
{
    for (int value = 0; value < 1441; ++value)
        add(value);
    EXPECT_EQ(axis.spanLength(), 4s);
    ASSERT_EQ(series.spans().size(), 721u);
    EXPECT_EQ(series.spans()[1].min, 2);
    EXPECT_EQ(series.spans()[1].mean, 2.5);
    EXPECT_EQ(series.spans()[1].max, 3);
    EXPECT_EQ(series.spans()[1].count, 2u);
    EXPECT_EQ(series.spans()[720].count, 1u);
}

TEST_F(SeriesTest, DayHasSpansOf64Seconds)
{
    for (int refresh = 0; refresh < 43'200; ++refresh)
        add(refresh % 100 == 0 ? -140 : refresh % 100 - 120);
    EXPECT_EQ(axis.spanLength(), 64s);
    EXPECT_EQ(series.spans().size(), 1350u);
    EXPECT_LE(series.spans().capacity(), SeriesAxis::Spans);
    std::uint32_t kept = 0;
    for (const Series::Span& span : series.spans())
        kept += span.count;
    EXPECT_EQ(kept, 43'200u);
    EXPECT_EQ(series.statistics().count(), 43'200u);
}

TEST_F(SeriesTest, SeriesThatBeginsLateStandsAtItsTime)
{
    for (int refresh = 0; refresh < 2000; ++refresh)
        add(refresh < 1900 ? std::nullopt : std::optional(5.0));
    ASSERT_EQ(axis.spanLength(), 4s);
    EXPECT_EQ(series.spans().at(949).count, 0u);
    EXPECT_EQ(series.spans().at(950).count, 2u);
}

TEST_F(SeriesTest, JumpOverYearsIsOneValueMore)
{
    add(1);
    series.add(axis, axis.advance(Start + std::chrono::years(60)), 3);
    EXPECT_LT(axis.span(), SeriesAxis::Spans);
    EXPECT_EQ(series.spans().front().count, 1u);
    EXPECT_EQ(series.spans().back().mean, 3);
    EXPECT_EQ(series.recent(axis, 1), 3.0);
}

TEST_F(SeriesTest, TimeThatRunsBackwardsStandsStill)
{
    axis.advance(Start + 10s);
    axis.advance(Start);
    EXPECT_EQ(axis.now(), Start + 10s);
    EXPECT_EQ(axis.start(), Start + 10s);
}

} // namespace
} // namespace spectrel
