#include "Analysis/Series/Statistics.h"

#include <cmath>
#include <gtest/gtest.h>
#include <limits>

namespace spectrel {
namespace {

Statistics of(std::initializer_list<double> values)
{
    Statistics statistics;
    for (const double value : values)
        statistics.add(value);
    return statistics;
}

TEST(StatisticsTest, NothingIsZero)
{
    const Statistics none;
    EXPECT_EQ(none.count(), 0u);
    EXPECT_EQ(none.mean(), 0);
    EXPECT_EQ(none.percentile(0.5), 0);
    EXPECT_TRUE(none.distribution().empty());
}

TEST(StatisticsTest, ExtremesAndMeanAreExact)
{
    const Statistics levels = of({-104.5, -90, -99.5});
    EXPECT_EQ(levels.count(), 3u);
    EXPECT_EQ(levels.min(), -104.5);
    EXPECT_EQ(levels.max(), -90);
    EXPECT_DOUBLE_EQ(levels.mean(), -98);
}

TEST(StatisticsTest, PercentilesOfOneToHundredAreExactToAClass)
{
    Statistics numbers;
    for (int number = 100; number >= 1; --number)
        numbers.add(number);
    ASSERT_LE(numbers.classWidth(), 0.5);
    EXPECT_EQ(numbers.percentile(0), 1);
    EXPECT_EQ(numbers.percentile(0.05), 5);
    EXPECT_EQ(numbers.percentile(0.5), 50);
    EXPECT_EQ(numbers.percentile(0.95), 95);
    EXPECT_EQ(numbers.percentile(1), 100);
}

TEST(StatisticsTest, DistributionCountsEachClass)
{
    const auto classes = of({-3, -3, -2.9375, -2.8125}).distribution();
    ASSERT_EQ(classes.size(), 4u);
    EXPECT_EQ(classes[0].from, -3);
    EXPECT_EQ(classes[0].count, 2u);
    EXPECT_EQ(classes[1].count, 1u);
    EXPECT_EQ(classes[2].count, 0u);
    EXPECT_EQ(classes[3].count, 1u);
}

TEST(StatisticsTest, ClassesWidenUntilAllValuesFit)
{
    Statistics statistics = of({1, 2, 3});
    EXPECT_EQ(statistics.classWidth(), 1.0 / 16);
    statistics.add(-1000);
    EXPECT_EQ(statistics.classWidth(), 4);
    std::uint32_t counted = 0;
    for (const auto& each : statistics.distribution())
        counted += each.count;
    EXPECT_EQ(counted, 4u);
    EXPECT_EQ(statistics.percentile(0.25), -1000);
    EXPECT_EQ(statistics.percentile(1), 0); // the class from 0 to 4
}

TEST(StatisticsTest, AbsurdValuesAreBoundedOrLeftOut)
{
    constexpr double Infinity = std::numeric_limits<double>::infinity();
    Statistics statistics = of({1e30, -1e30, 1e-30, 0});
    for (const double value : {Infinity, -Infinity, std::nan(""), 1e31})
        statistics.add(value);
    EXPECT_EQ(statistics.count(), 4u);
    EXPECT_LE(statistics.distribution().size(), Statistics::Classes);
}

} // namespace
} // namespace spectrel
