#include "Telephony/Simulator/Propagation.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(PathLossTest, FollowsTheUrbanMacroCell)
{
    EXPECT_DOUBLE_EQ(pathLoss(1000), 128.1);
    EXPECT_NEAR(pathLoss(100), 90.5, 1e-9);
    EXPECT_EQ(pathLoss(0), pathLoss(35));
}

} // namespace
} // namespace spectrel
