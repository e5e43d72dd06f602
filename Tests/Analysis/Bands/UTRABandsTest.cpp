#include "Analysis/Bands/Bands.h"
#include "Tests/Analysis/Bands/ChannelText.h"

#include <gmock/gmock.h>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::string> bandsOf(std::uint32_t channel, std::optional<std::string_view> band = std::nullopt)
{
    return channelTexts(bandsOfChannel(ChannelNumbering::UTRAFDD, channel, band));
}

std::vector<std::string> bandsOfTDD(std::uint32_t channel)
{
    return channelTexts(bandsOfChannel(ChannelNumbering::UTRATDD, channel));
}

TEST(UTRABandsTest, GeneralChannels)
{
    EXPECT_THAT(bandsOf(10562), ElementsAre("1 FDD downlink 10562=2112.4000 9612=1922.4000"));
    EXPECT_THAT(bandsOf(10838), ElementsAre("1 FDD downlink 10838=2167.6000 9888=1977.6000"));
    EXPECT_THAT(bandsOf(1162, "3"),
        ElementsAre("3 FDD downlink 1162=1807.4000 937=1712.4000", "3 FDD uplink 1387=1852.4000 1162=1757.4000"));
    EXPECT_THAT(bandsOf(2563, "7"), ElementsAre("7 FDD downlink 2563=2687.6000 2338=2567.6000"));
    EXPECT_THAT(bandsOf(2937),
        ElementsAre("8 FDD downlink 2937=927.4000 2712=882.4000", "10 FDD uplink 3162=2122.4000 2937=1722.4000"));
    EXPECT_THAT(bandsOf(9237), ElementsAre("9 FDD downlink 9237=1847.4000 8762=1752.4000"));
    EXPECT_THAT(bandsOf(3712, "11"), ElementsAre("11 FDD downlink 3712=1478.4000 3487=1430.4000"));
    EXPECT_THAT(bandsOf(3903, "12"), ElementsAre("12 FDD downlink 3903=743.6000 3678=713.6000"));
    EXPECT_THAT(bandsOf(4017), ElementsAre("13 FDD downlink 4017=748.4000 3792=779.4000"));
    EXPECT_THAT(bandsOf(4117), ElementsAre("14 FDD downlink 4117=760.4000 3892=790.4000"));
    EXPECT_THAT(bandsOf(712), ElementsAre("19 FDD downlink 712=877.4000 312=832.4000"));
    EXPECT_THAT(bandsOf(4512, "20"), ElementsAre("20 FDD downlink 4512=793.4000 4287=834.4000"));
    EXPECT_THAT(bandsOf(912), ElementsAre("21 FDD downlink 912=1508.4000 512=1460.4000"));
    EXPECT_THAT(bandsOf(5038, "22"), ElementsAre("22 FDD downlink 5038=3587.6000 4813=3487.6000"));
    EXPECT_THAT(bandsOf(5413), ElementsAre("25 FDD downlink 5413=1992.6000 5188=1912.6000"));
    EXPECT_THAT(bandsOf(5762, "26"),
        ElementsAre("26 FDD downlink 5762=861.4000 5537=816.4000", "26 FDD uplink 5987=871.5000 5762=826.5000"));
    EXPECT_THAT(bandsOf(6617), ElementsAre("32 SDL downlink 6617=1454.4000"));
    EXPECT_THAT(bandsOf(6813), ElementsAre("32 SDL downlink 6813=1493.6000"));
}

TEST(UTRABandsTest, AdditionalChannelsStandHalfARasterBeside)
{
    EXPECT_THAT(bandsOf(412, "2"), ElementsAre("2 FDD downlink 412=1932.5000 12=1852.5000"));
    EXPECT_THAT(bandsOf(687), ElementsAre("2 FDD downlink 687=1987.5000 287=1907.5000"));
    EXPECT_THAT(bandsOf(2087, "4"), ElementsAre("4 FDD downlink 2087=2152.5000 1862=1752.5000"));
    EXPECT_THAT(bandsOf(1007, "5"), ElementsAre("5 FDD downlink 1007=871.5000 782=826.5000"));
    EXPECT_THAT(bandsOf(1032, "5"), ElementsAre("5 FDD downlink 1032=876.5000 807=831.5000"));
    EXPECT_THAT(bandsOf(1087, "5"), ElementsAre("5 FDD downlink 1087=887.5000 862=842.5000"));
    EXPECT_THAT(bandsOf(2912, "7"), ElementsAre("7 FDD downlink 2912=2687.5000 2687=2567.5000"));
    EXPECT_THAT(bandsOf(3412, "10"),
        ElementsAre("10 FDD downlink 3412=2112.5000 3187=1712.5000", "10 FDD uplink 3637=2157.5000 3412=1757.5000"));
    EXPECT_THAT(bandsOf(3957), ElementsAre("12 FDD downlink 3957=736.5000 3732=706.5000"));
    EXPECT_THAT(bandsOf(3962), ElementsAre("12 FDD downlink 3962=737.5000 3737=707.5000"));
    EXPECT_THAT(bandsOf(3992), ElementsAre("12 FDD downlink 3992=743.5000 3767=713.5000"));
    EXPECT_THAT(bandsOf(4092), ElementsAre("13 FDD downlink 4092=753.5000 3867=784.5000"));
    EXPECT_THAT(bandsOf(4192, "14"), ElementsAre("14 FDD downlink 4192=765.5000 3967=795.5000"));
    EXPECT_THAT(bandsOf(837, "19"), ElementsAre("19 FDD downlink 837=887.5000 437=842.5000"));
    EXPECT_THAT(bandsOf(6592), ElementsAre("25 FDD downlink 6592=1992.5000 6367=1912.5000"));
    EXPECT_THAT(bandsOf(6012), ElementsAre("26 FDD downlink 6012=876.5000 5787=831.5000"));
}

TEST(UTRABandsTest, NumbersBetweenAdditionalChannelsHaveNone)
{
    EXPECT_THAT(bandsOf(413), IsEmpty());
    EXPECT_THAT(bandsOf(712, "2"), IsEmpty()); // one step past the last
    EXPECT_THAT(bandsOf(0), IsEmpty());
    EXPECT_THAT(bandsOf(16384), IsEmpty());
}

TEST(UTRABandsTest, OneNumberInSeveralBands)
{
    EXPECT_THAT(bandsOf(4400),
        ElementsAre("5 FDD downlink 4400=880.0000 4175=835.0000", "6 FDD downlink 4400=880.0000 4175=835.0000",
            "20 FDD uplink 4625=816.0000 4400=857.0000"));
    EXPECT_THAT(bandsOf(9700),
        ElementsAre("1 FDD uplink 10650=2130.0000 9700=1940.0000", "2 FDD downlink 9700=1940.0000 9300=1860.0000"));
    EXPECT_THAT(bandsOf(9700, "2"), ElementsAre("2 FDD downlink 9700=1940.0000 9300=1860.0000"));
    EXPECT_THAT(bandsOf(1037),
        ElementsAre("3 FDD uplink 1262=1827.4000 1037=1732.4000", "5 FDD downlink 1037=877.5000 812=832.5000",
            "6 FDD downlink 1037=877.5000 812=832.5000"));
}

TEST(UTRABandsTest, TimeDivisionIsFiveTimesTheFrequency)
{
    EXPECT_THAT(bandsOfTDD(10054), ElementsAre("34 TDD both 10054=2010.8000 10054=2010.8000"));
    EXPECT_THAT(bandsOfTDD(10121), ElementsAre("34 TDD both 10121=2024.2000 10121=2024.2000"));
    EXPECT_THAT(bandsOfTDD(12854), ElementsAre("38 TDD both 12854=2570.8000 12854=2570.8000"));
    EXPECT_THAT(bandsOfTDD(13096), ElementsAre("38 TDD both 13096=2619.2000 13096=2619.2000"));
    EXPECT_THAT(bandsOfTDD(11504), ElementsAre("40 TDD both 11504=2300.8000 11504=2300.8000"));
    EXPECT_THAT(bandsOfTDD(11996), ElementsAre("40 TDD both 11996=2399.2000 11996=2399.2000"));
    EXPECT_THAT(bandsOfTDD(9404),
        ElementsAre("35 TDD both 9404=1880.8000 9404=1880.8000", "39 TDD both 9404=1880.8000 9404=1880.8000"));
    EXPECT_THAT(bandsOfTDD(9596),
        ElementsAre("33 TDD both 9596=1919.2000 9596=1919.2000", "37 TDD both 9596=1919.2000 9596=1919.2000",
            "39 TDD both 9596=1919.2000 9596=1919.2000"));
    for (const std::uint32_t edge : {9253u, 9597u + 50, 9947u, 10053u, 10122u, 11503u, 11997u, 12853u, 13097u})
        EXPECT_THAT(bandsOfTDD(edge), IsEmpty()) << edge;
}

} // namespace
} // namespace spectrel
