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
    return channelTexts(bandsOfChannel(ChannelNumbering::GSM, channel));
}

TEST(GSMBandsTest, EachNumberOfTheNineHundredBandsIsInTheNarrowest)
{
    EXPECT_THAT(bandsOf(1), ElementsAre("P-GSM 900 FDD both 1=935.2000 1=890.2000"));
    EXPECT_THAT(bandsOf(62), ElementsAre("P-GSM 900 FDD both 62=947.4000 62=902.4000"));
    EXPECT_THAT(bandsOf(124), ElementsAre("P-GSM 900 FDD both 124=959.8000 124=914.8000"));
    EXPECT_THAT(bandsOf(0), ElementsAre("E-GSM 900 FDD both 0=935.0000 0=890.0000"));
    EXPECT_THAT(bandsOf(975), ElementsAre("E-GSM 900 FDD both 975=925.2000 975=880.2000"));
    EXPECT_THAT(bandsOf(1023), ElementsAre("E-GSM 900 FDD both 1023=934.8000 1023=889.8000"));
    EXPECT_THAT(bandsOf(955), ElementsAre("R-GSM 900 FDD both 955=921.2000 955=876.2000"));
    EXPECT_THAT(bandsOf(974), ElementsAre("R-GSM 900 FDD both 974=925.0000 974=880.0000"));
}

TEST(GSMBandsTest, TheOtherBands)
{
    EXPECT_THAT(bandsOf(128), ElementsAre("GSM 850 FDD both 128=869.2000 128=824.2000"));
    EXPECT_THAT(bandsOf(251), ElementsAre("GSM 850 FDD both 251=893.8000 251=848.8000"));
    EXPECT_THAT(bandsOf(811), ElementsAre("DCS 1800 FDD both 811=1865.0000 811=1770.0000"));
    EXPECT_THAT(bandsOf(885), ElementsAre("DCS 1800 FDD both 885=1879.8000 885=1784.8000"));
}

TEST(GSMBandsTest, NumbersFrom512To810AreOfBothHighBands)
{
    EXPECT_THAT(bandsOf(512),
        ElementsAre("DCS 1800 FDD both 512=1805.2000 512=1710.2000", "PCS 1900 FDD both 512=1930.2000 512=1850.2000"));
    EXPECT_THAT(bandsOf(810),
        ElementsAre("DCS 1800 FDD both 810=1864.8000 810=1769.8000", "PCS 1900 FDD both 810=1989.8000 810=1909.8000"));
}

TEST(GSMBandsTest, NumbersBetweenTheBandsHaveNone)
{
    for (const std::uint32_t gap : {125u, 127u, 252u, 511u, 886u, 954u, 1024u})
        EXPECT_THAT(bandsOf(gap), IsEmpty()) << gap;
}

} // namespace
} // namespace spectrel
