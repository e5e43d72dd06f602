#include "Telephony/Modem/ModemFacts.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(Hexadecimal, ReadsWithoutPrefix)
{
    EXPECT_EQ(hexadecimal("84CD"), 0x84CDu);
    EXPECT_EQ(hexadecimal("1cead8f0"), 0x1CEAD8F0u);
    EXPECT_EQ(hexadecimal("10"), 16u);
    EXPECT_EQ(hexadecimal("FFFFFFFF"), 0xFFFFFFFFu);
}

TEST(Hexadecimal, AnythingElseIsNotKnown)
{
    for (const char* text : {"", "0x10", "-1", " 1", "1 ", "8G", "100000000"})
        EXPECT_EQ(hexadecimal(text), std::nullopt) << text;
}

TEST(ParseLocation, SplitsAndReadsTheFiveFields)
{
    const auto location = parseLocation("310,026,8BE3,2BAF,6FFE");
    ASSERT_TRUE(location);
    EXPECT_EQ(location->operatorId, "310026");
    EXPECT_EQ(location->locationArea, 0x8BE3u);
    EXPECT_EQ(location->cellId, 0x2BAFu);
    EXPECT_EQ(location->trackingArea, 0x6FFEu);
}

TEST(ParseLocation, OlderFormHasNoTrackingArea)
{
    const auto location = parseLocation("250,40,CE00,1CEAD8F0");
    ASSERT_TRUE(location);
    EXPECT_EQ(location->operatorId, "25040");
    EXPECT_EQ(location->trackingArea, std::nullopt);
}

TEST(ParseLocation, ZeroIsNotKnown)
{
    const auto location = parseLocation("001,01,0000,00002BAF,000000");
    ASSERT_TRUE(location);
    EXPECT_EQ(location->locationArea, std::nullopt);
    EXPECT_EQ(location->trackingArea, std::nullopt);
    EXPECT_EQ(location->cellId, 0x2BAFu);
}

TEST(ParseLocation, AnythingElseIsNone)
{
    for (const char* text :
        {"", ",,,", "001,01,84CD", "01,001,84CD,2BAF", "001,1,84CD,2BAF", "001,01,1,2,3,4", "a,b,c,d"})
        EXPECT_FALSE(parseLocation(text)) << text;
}

TEST(NetworkName, KeepsLeadingZerosAndTheNetworkCodesLength)
{
    EXPECT_EQ(networkName("00101"), "001-01");
    EXPECT_EQ(networkName("001001"), "001-001");
    EXPECT_EQ(networkName("home"), "home");
    EXPECT_EQ(networkName(""), "");
}

} // namespace
} // namespace spectrel
