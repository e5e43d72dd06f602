#include "Analysis/Report/Distribution.h"

#include <cmath>
#include <gtest/gtest.h>
#include <optional>

namespace spectrel {
namespace {

TEST(DistributionTest, OfNothingNothingIsKnown)
{
    const Distribution none;
    EXPECT_EQ(none.count(), 0u);
    EXPECT_EQ(none.min(), std::nullopt);
    EXPECT_EQ(none.mean(), std::nullopt);
    EXPECT_EQ(none.max(), std::nullopt);
    EXPECT_EQ(none.percentile(0.5), std::nullopt);
}

TEST(DistributionTest, PercentilesAreTheLevelAtOrBelowWhichTheShareIs)
{
    Distribution levels;
    for (int level = -110; level < -90; ++level)
        levels.add(level);
    EXPECT_EQ(levels.percentile(0.05), -110);
    EXPECT_EQ(levels.percentile(0.5), -101);
    EXPECT_EQ(levels.percentile(1), -91);
    EXPECT_EQ(levels.mean(), -100.5);
}

TEST(DistributionTest, EndsAreExactAndPercentilesStayWithinThem)
{
    Distribution levels;
    levels.add(-101.3);
    EXPECT_EQ(levels.min(), -101.3);
    EXPECT_EQ(levels.max(), -101.3);
    EXPECT_EQ(levels.percentile(0.5), -101.3);
}

TEST(DistributionTest, AbsurdNumbersTakeNoMoreRoomThanTheLimit)
{
    Distribution levels;
    levels.add(std::nan(""));
    EXPECT_EQ(levels.count(), 0u);
    levels.add(1e300);
    levels.add(-1e300);
    EXPECT_EQ(levels.max(), Distribution::Limit);
    EXPECT_EQ(levels.min(), -Distribution::Limit);
    EXPECT_EQ(levels.classes().size(), 2u);
}

} // namespace
} // namespace spectrel
