#include "Analysis/Bands/Bands.h"
#include "Tests/Analysis/Bands/ChannelText.h"

#include <gmock/gmock.h>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> channelIn(std::string_view bandClass, std::uint32_t channel)
{
    return channelTexts(bandsOfChannel(ChannelNumbering::CDMA, channel, bandClass));
}

TEST(CDMABandClassesTest, CellularNumbersWrapBelowTheirFirst)
{
    EXPECT_THAT(channelIn("0", 1), ElementsAre("0 FDD both 1=870.0300 1=825.0300"));
    EXPECT_THAT(channelIn("0", 283), ElementsAre("0 FDD both 283=878.4900 283=833.4900"));
    EXPECT_THAT(channelIn("0", 384), ElementsAre("0 FDD both 384=881.5200 384=836.5200"));
    EXPECT_THAT(channelIn("0", 799), ElementsAre("0 FDD both 799=893.9700 799=848.9700"));
    EXPECT_THAT(channelIn("0", 991), ElementsAre("0 FDD both 991=869.0400 991=824.0400"));
    EXPECT_THAT(channelIn("0", 1023), ElementsAre("0 FDD both 1023=870.0000 1023=825.0000"));
    EXPECT_THAT(channelIn("0", 1024), ElementsAre("0 FDD both 1024=860.0400 1024=815.0400"));
    EXPECT_THAT(channelIn("0", 1323), ElementsAre("0 FDD both 1323=869.0100 1323=824.0100"));
    for (const std::uint32_t gap : {0u, 800u, 990u, 1324u})
        EXPECT_THAT(channelIn("0", gap), IsEmpty()) << gap;
}

TEST(CDMABandClassesTest, AChannelOfEachFurtherClass)
{
    EXPECT_THAT(channelIn("1", 25), ElementsAre("1 FDD both 25=1931.2500 25=1851.2500"));
    EXPECT_THAT(channelIn("1", 1199), ElementsAre("1 FDD both 1199=1989.9500 1199=1909.9500"));
    EXPECT_THAT(channelIn("2", 0), ElementsAre("2 FDD both 0=934.9875 0=889.9875"));
    EXPECT_THAT(channelIn("2", 2047), ElementsAre("2 FDD both 2047=934.9625 2047=889.9625"));
    EXPECT_THAT(channelIn("3", 1), ElementsAre("3 FDD both 1=860.0125 1=915.0125"));
    EXPECT_THAT(channelIn("3", 1600), ElementsAre("3 FDD both 1600=843.0000 1600=898.0000"));
    EXPECT_THAT(channelIn("4", 599), ElementsAre("4 FDD both 599=1869.9500 599=1779.9500"));
    EXPECT_THAT(channelIn("5", 160), ElementsAre("5 FDD both 160=463.9750 160=453.9750"));
    EXPECT_THAT(channelIn("5", 1039), ElementsAre("5 FDD both 1039=461.3100 1039=451.3100"));
    EXPECT_THAT(channelIn("5", 2016), ElementsAre("5 FDD both 2016=493.4800 2016=483.4800"));
    EXPECT_THAT(channelIn("6", 100), ElementsAre("6 FDD both 100=2115.0000 100=1925.0000"));
    EXPECT_THAT(channelIn("7", 240), ElementsAre("7 FDD both 240=758.0000 240=788.0000"));
    EXPECT_THAT(channelIn("8", 1499), ElementsAre("8 FDD both 1499=1879.9500 1499=1784.9500"));
    EXPECT_THAT(channelIn("9", 699), ElementsAre("9 FDD both 699=959.9500 699=914.9500"));
    EXPECT_THAT(channelIn("10", 720), ElementsAre("10 FDD both 720=935.0000 720=896.0000"));
    EXPECT_THAT(channelIn("11", 472), ElementsAre("11 FDD both 472=420.0000 472=410.0000"));
    EXPECT_THAT(channelIn("12", 239), ElementsAre("12 FDD both 239=920.9875 239=875.9875"));
    EXPECT_THAT(channelIn("13", 1399), ElementsAre("13 FDD both 1399=2689.9500 1399=2569.9500"));
    EXPECT_THAT(channelIn("14", 1299), ElementsAre("14 FDD both 1299=1994.9500 1299=1914.9500"));
    EXPECT_THAT(channelIn("15", 450), ElementsAre("15 FDD both 450=2132.5000 450=1732.5000"));
    EXPECT_THAT(channelIn("16", 1459), ElementsAre("16 FDD both 1459=2689.9500 1459=2567.9500"));
    EXPECT_THAT(channelIn("18", 0), ElementsAre("18 FDD both 0=757.0000 0=787.0000"));
    EXPECT_THAT(channelIn("19", 360), ElementsAre("19 FDD both 360=746.0000 360=716.0000"));
    EXPECT_THAT(channelIn("20", 680), ElementsAre("20 FDD both 680=1559.0000 680=1660.5000"));
    EXPECT_THAT(channelIn("21", 0), ElementsAre("21 FDD both 0=2180.0000 0=2000.0000"));
}

TEST(CDMABandClassesTest, TheForwardLinkAloneOfClass17)
{
    EXPECT_THAT(channelIn("17", 140), ElementsAre("17 SDL downlink 140=2624.0000"));
    EXPECT_THAT(channelIn("17", 1460), IsEmpty());
}

TEST(CDMABandClassesTest, WithoutABandEveryClassWithTheNumberIsThere)
{
    std::vector<std::string> classes;
    for (const BandChannel& channel : bandsOfChannel(ChannelNumbering::CDMA, 283))
        classes.emplace_back(channel.band);
    EXPECT_THAT(classes,
        ElementsAre(
            "0", "1", "2", "3", "4", "5", "6", "8", "9", "10", "11", "13", "14", "15", "16", "17", "19", "20", "21"));
}

} // namespace
} // namespace spectrel
