#include "Telephony/Modem/FrequencyBands.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(LTEBand, BothEdgesOfABand)
{
    EXPECT_EQ(lteBand(0), 1u);
    EXPECT_EQ(lteBand(1199), 2u);
    EXPECT_EQ(lteBand(1200), 3u);
    EXPECT_EQ(lteBand(1949), 3u);
    EXPECT_EQ(lteBand(1950), 4u);
    EXPECT_EQ(lteBand(6300), 20u);
    EXPECT_EQ(lteBand(66436), 66u);
    EXPECT_EQ(lteBand(70645), 88u);
}

TEST(LTEBand, ChannelBetweenTheBandsHasNone)
{
    for (const std::uint32_t channel : {4950u, 5009u, 10360u, 35999u, 60255u, 65535u, 70646u, 0xFFFFFFFFu})
        EXPECT_EQ(lteBand(channel), std::nullopt) << channel;
}

} // namespace
} // namespace spectrel
