#include "Values/Moment.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(MomentTest, SecondsHaveSixDecimals)
{
    using std::chrono::microseconds;
    EXPECT_EQ(secondsForm(Moment(microseconds(1'733'000'000'123'456))), "1733000000.123456");
    EXPECT_EQ(secondsForm(Moment(microseconds(1'000'001))), "1.000001");
    EXPECT_EQ(secondsForm(Moment()), "0.000000");
}

} // namespace
} // namespace spectrel
