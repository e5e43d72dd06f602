#include "Telephony/Simulator/CDMA/EVDOTraffic.h"

#include <gtest/gtest.h>
#include <utility>

namespace spectrel {
namespace {

using namespace std::chrono_literals;

TEST(EVDOTrafficTest, BitsAreThoseOfThePackets)
{
    Dice dice(5);
    EVDOTraffic traffic;
    for (int step = 0; step < 1000; ++step)
        traffic.advance(100ms, dice.between(-18, 15), dice.between(-40, 23), dice);
    std::uint64_t forward = 0;
    for (std::size_t format = 0; format < ForwardFormats.size(); ++format)
        forward += std::uint64_t(traffic.counts().forward[format]) * ForwardFormats[format].bits;
    EXPECT_EQ(forward, traffic.counts().forwardBits);
    std::uint64_t reverse = 0;
    for (std::size_t interlace = 0; interlace < EVDOCounts::Interlaces; ++interlace) {
        for (std::size_t mode = 0; mode < EVDOCounts::Modes; ++mode) {
            for (std::size_t payload = 0; payload < ReversePayloads.size(); ++payload) {
                for (const std::uint32_t arrived : traffic.counts().reverse[interlace][mode][payload].arrived)
                    reverse += std::uint64_t(arrived) * ReversePayloads[payload];
            }
        }
    }
    EXPECT_EQ(reverse, traffic.counts().reverseBits);
}

TEST(EVDOTrafficTest, BetterSignalCarriesMore)
{
    const auto carried = [](double signal, double power) {
        Dice dice(5);
        EVDOTraffic traffic;
        for (int step = 0; step < 100; ++step)
            traffic.advance(100ms, signal, power, dice);
        return std::pair(traffic.counts().forwardBits, traffic.counts().reverseBits);
    };
    EXPECT_GT(carried(12, -10).first, 3 * carried(0, -10).first);
    EXPECT_GT(carried(0, -10).first, 3 * carried(-10, -10).first);
    EXPECT_GT(carried(-20, -10).first, 0u) << "the lowest rate always works";
    EXPECT_LE(carried(12, -10).first, 10u * 3'072'000) << "ten seconds at the highest rate";
    EXPECT_GT(carried(0, -10).second, 3 * carried(0, 20).second);
}

} // namespace
} // namespace spectrel
