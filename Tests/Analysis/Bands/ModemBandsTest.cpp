#include "Analysis/Bands/Bands.h"
#include "Telephony/Modem/FrequencyBands.h"

#include <gtest/gtest.h>
#include <optional>
#include <string>

namespace spectrel {
namespace {

/// The telephony service has a table of its own, for it uses nothing of the application's side.
TEST(ModemBandsTest, TheServiceKnowsTheSameBands)
{
    constexpr std::uint32_t Unlicensed = 255144; // bands 252 and 255, which modems do not report
    for (std::uint32_t channel = 0; channel < Unlicensed; ++channel) {
        const auto known = lteBand(channel);
        ASSERT_EQ(findDownlinkChannel(ChannelNumbering::EUTRA, channel).band, known ? std::to_string(*known) : "")
            << channel;
    }
}

} // namespace
} // namespace spectrel
