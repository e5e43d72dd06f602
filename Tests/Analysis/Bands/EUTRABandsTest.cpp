#include "Analysis/Bands/Bands.h"
#include "Tests/Analysis/Bands/ChannelText.h"

#include <gmock/gmock.h>
#include <string>
#include <vector>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> bandsOf(std::uint32_t channel)
{
    return channelTexts(bandsOfChannel(ChannelNumbering::EUTRA, channel));
}

TEST(EUTRABandsTest, TheFirstAndLastChannelsOfAPairedBand)
{
    EXPECT_THAT(bandsOf(0), ElementsAre("1 FDD downlink 0=2110.0000 18000=1920.0000"));
    EXPECT_THAT(bandsOf(599), ElementsAre("1 FDD downlink 599=2169.9000 18599=1979.9000"));
    EXPECT_THAT(bandsOf(600), ElementsAre("2 FDD downlink 600=1930.0000 18600=1850.0000"));
    EXPECT_THAT(bandsOf(1200), ElementsAre("3 FDD downlink 1200=1805.0000 19200=1710.0000"));
    EXPECT_THAT(bandsOf(1949), ElementsAre("3 FDD downlink 1949=1879.9000 19949=1784.9000"));
    EXPECT_THAT(bandsOf(3800), ElementsAre("9 FDD downlink 3800=1844.9000 21800=1749.9000"));
    EXPECT_THAT(bandsOf(4949), ElementsAre("11 FDD downlink 4949=1495.8000 22949=1447.8000"));
    EXPECT_THAT(bandsOf(9919), ElementsAre("31 FDD downlink 9919=467.4000 27809=457.4000"));
}

TEST(EUTRABandsTest, UplinkNumbersLeadToTheirPair)
{
    EXPECT_THAT(bandsOf(19300), ElementsAre("3 FDD uplink 1300=1815.0000 19300=1720.0000"));
    EXPECT_THAT(bandsOf(18000), ElementsAre("1 FDD uplink 0=2110.0000 18000=1920.0000"));
    EXPECT_THAT(bandsOf(27809), ElementsAre("31 FDD uplink 9919=467.4000 27809=457.4000"));
    EXPECT_THAT(bandsOf(131072), ElementsAre("65 FDD uplink 65536=2110.0000 131072=1920.0000"));
    EXPECT_THAT(bandsOf(134281), ElementsAre("88 FDD uplink 70645=426.9000 134281=416.9000"));
}

TEST(EUTRABandsTest, WhereTheUplinkIsAboveTheDownlink)
{
    EXPECT_THAT(bandsOf(5230), ElementsAre("13 FDD downlink 5230=751.0000 23230=782.0000"));
    EXPECT_THAT(bandsOf(5330), ElementsAre("14 FDD downlink 5330=763.0000 23330=793.0000"));
    EXPECT_THAT(bandsOf(6300), ElementsAre("20 FDD downlink 6300=806.0000 24300=847.0000"));
    EXPECT_THAT(bandsOf(7700), ElementsAre("24 FDD downlink 7700=1525.0000 25700=1626.5000"));
    EXPECT_THAT(bandsOf(68586), ElementsAre("71 FDD downlink 68586=617.0000 133122=663.0000"));
}

TEST(EUTRABandsTest, SupplementalDownlinksHaveNoUplink)
{
    EXPECT_THAT(bandsOf(9660), ElementsAre("29 SDL downlink 9660=717.0000"));
    EXPECT_THAT(bandsOf(9769), ElementsAre("29 SDL downlink 9769=727.9000"));
    EXPECT_THAT(bandsOf(10359), ElementsAre("32 SDL downlink 10359=1495.9000"));
    EXPECT_THAT(bandsOf(67336), ElementsAre("67 SDL downlink 67336=738.0000"));
    EXPECT_THAT(bandsOf(68335), ElementsAre("69 SDL downlink 68335=2619.9000"));
    EXPECT_THAT(bandsOf(69466), ElementsAre("75 SDL downlink 69466=1432.0000"));
    EXPECT_THAT(bandsOf(70365), ElementsAre("76 SDL downlink 70365=1431.9000"));
    EXPECT_THAT(bandsOf(255144), ElementsAre("252 SDL downlink 255144=5150.0000"));
    EXPECT_THAT(bandsOf(256143), ElementsAre("252 SDL downlink 256143=5249.9000"));
    EXPECT_THAT(bandsOf(260894), ElementsAre("255 SDL downlink 260894=5725.0000"));
    EXPECT_THAT(bandsOf(262143), ElementsAre("255 SDL downlink 262143=5849.9000"));
}

TEST(EUTRABandsTest, TheTopsOfBands66And70HaveNoPair)
{
    EXPECT_THAT(bandsOf(67135), ElementsAre("66 FDD downlink 67135=2179.9000 132671=1779.9000"));
    EXPECT_THAT(bandsOf(67136), ElementsAre("66 FDD downlink 67136=2180.0000"));
    EXPECT_THAT(bandsOf(67335), ElementsAre("66 FDD downlink 67335=2199.9000"));
    EXPECT_THAT(bandsOf(132671), ElementsAre("66 FDD uplink 67135=2179.9000 132671=1779.9000"));
    EXPECT_THAT(bandsOf(132672), ElementsAre("68 FDD uplink 67536=753.0000 132672=698.0000"));
    EXPECT_THAT(bandsOf(68485), ElementsAre("70 FDD downlink 68485=2009.9000 133121=1709.9000"));
    EXPECT_THAT(bandsOf(68486), ElementsAre("70 FDD downlink 68486=2010.0000"));
    EXPECT_THAT(bandsOf(68585), ElementsAre("70 FDD downlink 68585=2019.9000"));
}

TEST(EUTRABandsTest, TimeDivisionHasOneNumberAndFrequencyForBothWays)
{
    EXPECT_THAT(bandsOf(36000), ElementsAre("33 TDD both 36000=1900.0000 36000=1900.0000"));
    EXPECT_THAT(bandsOf(38000), ElementsAre("38 TDD both 38000=2595.0000 38000=2595.0000"));
    EXPECT_THAT(bandsOf(39649), ElementsAre("40 TDD both 39649=2399.9000 39649=2399.9000"));
    EXPECT_THAT(bandsOf(41589), ElementsAre("41 TDD both 41589=2689.9000 41589=2689.9000"));
    EXPECT_THAT(bandsOf(54539), ElementsAre("46 TDD both 54539=5924.9000 54539=5924.9000"));
    EXPECT_THAT(bandsOf(55240), ElementsAre("48 TDD both 55240=3550.0000 55240=3550.0000"));
    EXPECT_THAT(bandsOf(56740), ElementsAre("49 TDD both 56740=3550.0000 56740=3550.0000"));
    EXPECT_THAT(bandsOf(60254), ElementsAre("53 TDD both 60254=2494.9000 60254=2494.9000"));
}

TEST(EUTRABandsTest, NumbersBetweenTheBandsHaveNone)
{
    for (const std::uint32_t gap : {4950u, 5009u, 5380u, 5729u, 7400u, 7499u, 10360u, 17999u, 22950u, 23009u, 25400u,
             25499u, 27810u, 35999u, 60255u, 65535u, 70646u, 131071u, 134282u, 255143u, 256144u, 262144u, 4294967295u})
        EXPECT_THAT(bandsOf(gap), IsEmpty()) << gap;
}

} // namespace
} // namespace spectrel
