#include "Analysis/Bands/Bands.h"

#include "Tests/Analysis/Bands/ChannelText.h"

#include <gmock/gmock.h>
#include <limits>
#include <string>
#include <vector>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> at(ChannelNumbering numbering, double mhz)
{
    return channelTexts(channelsAtMHz(numbering, mhz));
}

TEST(ChannelsAtMHzTest, BothDirectionsAreFound)
{
    EXPECT_THAT(at(ChannelNumbering::EUTRA, 1815), ElementsAre("3 FDD downlink 1300=1815.0000 19300=1720.0000"));
    EXPECT_THAT(at(ChannelNumbering::EUTRA, 1735.0),
        ElementsAre("3 FDD uplink 1450=1830.0000 19450=1735.0000", "4 FDD uplink 2200=2135.0000 20200=1735.0000",
            "10 FDD uplink 4400=2135.0000 22400=1735.0000", "66 FDD uplink 66686=2135.0000 132222=1735.0000"));
    EXPECT_THAT(at(ChannelNumbering::GSM, 947.4), ElementsAre("P-GSM 900 FDD downlink 62=947.4000 62=902.4000"));
    EXPECT_THAT(at(ChannelNumbering::GSM, 902.4), ElementsAre("P-GSM 900 FDD uplink 62=947.4000 62=902.4000"));
    EXPECT_THAT(at(ChannelNumbering::UTRATDD, 2012.4), ElementsAre("34 TDD both 10062=2012.4000 10062=2012.4000"));
    EXPECT_THAT(at(ChannelNumbering::UTRAFDD, 882.5),
        ElementsAre("5 FDD downlink 1062=882.5000 837=837.5000", "6 FDD downlink 1062=882.5000 837=837.5000",
            "19 FDD downlink 812=882.5000 412=837.5000", "26 FDD downlink 6042=882.5000 5817=837.5000"));
}

TEST(ChannelsAtMHzTest, FrequenciesBetweenChannelsHaveNone)
{
    EXPECT_THAT(at(ChannelNumbering::EUTRA, 1815.05), IsEmpty());
    EXPECT_THAT(at(ChannelNumbering::GSM, 947.5), IsEmpty());
    EXPECT_THAT(at(ChannelNumbering::CDMA, 881.51), IsEmpty());
}

TEST(ChannelsAtMHzTest, NoNumberIsNoFrequency)
{
    for (const double mhz :
        {-1.0, 0.0, 1e300, std::numeric_limits<double>::infinity(), std::numeric_limits<double>::quiet_NaN()})
        EXPECT_THAT(at(ChannelNumbering::EUTRA, mhz), IsEmpty()) << mhz;
}

TEST(ChannelsAtMHzTest, EveryChannelLeadsBackToItself)
{
    for (const auto numbering : {ChannelNumbering::EUTRA, ChannelNumbering::UTRAFDD, ChannelNumbering::UTRATDD,
             ChannelNumbering::GSM, ChannelNumbering::CDMA}) {
        for (std::uint32_t number = 0; number < 300000; number += number < 3000 ? 1 : 7) {
            for (const BandChannel& channel : bandsOfChannel(numbering, number)) {
                const auto back = channelTexts(channelsAtMHz(numbering, channel.downlinkMHz, channel.band));
                BandChannel down = channel;
                if (channel.direction == ChannelDirection::Uplink || channel.duplex != Duplex::TDD)
                    down.direction = ChannelDirection::Downlink;
                ASSERT_THAT(back, testing::Contains(channelText(down))) << number;
            }
        }
    }
}

TEST(FindDownlinkChannelTest, TheOneBand)
{
    const DownlinkChannel found = findDownlinkChannel(ChannelNumbering::EUTRA, 1300);
    EXPECT_EQ(found.band, "3");
    EXPECT_EQ(found.downlinkMHz, 1815.0);
    EXPECT_EQ(found.uplinkMHz, 1720.0);
    EXPECT_EQ(found.duplex, Duplex::FDD);
}

TEST(FindDownlinkChannelTest, UplinkNumbersAreNotLookedAt)
{
    EXPECT_EQ(findDownlinkChannel(ChannelNumbering::EUTRA, 19300).band, "");
    EXPECT_EQ(findDownlinkChannel(ChannelNumbering::UTRAFDD, 9700).band, "2");
}

TEST(FindDownlinkChannelTest, WhereBandsDisagreeNothingIsKnown)
{
    const DownlinkChannel found = findDownlinkChannel(ChannelNumbering::GSM, 600);
    EXPECT_EQ(found.band, "");
    EXPECT_EQ(found.downlinkMHz, std::nullopt);
    EXPECT_EQ(found.uplinkMHz, std::nullopt);
    const DownlinkChannel hinted = findDownlinkChannel(ChannelNumbering::GSM, 600, "PCS 1900");
    EXPECT_EQ(hinted.band, "PCS 1900");
    EXPECT_EQ(hinted.downlinkMHz, 1947.8);
}

TEST(FindDownlinkChannelTest, WhereBandsShareTheirFrequenciesThoseAreKnown)
{
    const DownlinkChannel shared = findDownlinkChannel(ChannelNumbering::UTRAFDD, 4400);
    EXPECT_EQ(shared.band, "");
    EXPECT_EQ(shared.downlinkMHz, 880.0);
    EXPECT_EQ(shared.uplinkMHz, 835.0);
    const DownlinkChannel timeDivision = findDownlinkChannel(ChannelNumbering::UTRATDD, 9596);
    EXPECT_EQ(timeDivision.band, "");
    EXPECT_EQ(timeDivision.downlinkMHz, 1919.2);
    EXPECT_EQ(timeDivision.duplex, Duplex::TDD);
}

TEST(FindDownlinkChannelTest, AHintThatContradictsTheChannelLeavesNothing)
{
    const DownlinkChannel found = findDownlinkChannel(ChannelNumbering::EUTRA, 1300, "7");
    EXPECT_EQ(found.band, "");
    EXPECT_EQ(found.downlinkMHz, std::nullopt);
}

} // namespace
} // namespace spectrel
