#include "Telephony/Modem/ModemFacts.h"

#include "Telephony/Modem/FrequencyBands.h"
#include "Telephony/Modem/ModemChoice.h"

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

ModemFacts modem(const std::string& id, bool isEnabled, bool isRegistered)
{
    ModemFacts facts;
    facts.id = "/modems/" + id;
    facts.model = "Model" + id;
    facts.port = "cdc-wdm" + id;
    facts.isEnabled = isEnabled;
    facts.isRegistered = isRegistered;
    return facts;
}

std::string chosen(const std::vector<ModemFacts>& modems, std::string_view wish = {}, std::string_view current = {})
{
    const ModemFacts* facts = chooseModem(modems, wish, current);
    return facts ? facts->id : "none";
}

TEST(ChooseModem, RegisteredBeforeEnabledBeforeTheFirst)
{
    EXPECT_EQ(chosen({}), "none");
    EXPECT_EQ(chosen({modem("0", false, false), modem("1", false, false)}), "/modems/0");
    EXPECT_EQ(chosen({modem("0", false, false), modem("1", true, false)}), "/modems/1");
    EXPECT_EQ(chosen({modem("0", true, false), modem("1", true, true), modem("2", true, true)}), "/modems/1");
}

TEST(ChooseModem, TheOneInUseStaysWhileItIsEnabled)
{
    EXPECT_EQ(chosen({modem("0", true, true), modem("1", true, false)}, "", "/modems/1"), "/modems/1");
    EXPECT_EQ(chosen({modem("0", true, true), modem("1", false, false)}, "", "/modems/1"), "/modems/0");
    EXPECT_EQ(chosen({modem("0", true, true)}, "", "/modems/1"), "/modems/0");
}

TEST(ChooseModem, WishIsANumberAPathAModelOrAPort)
{
    const std::vector modems {modem("0", true, true), modem("1", false, false)};
    EXPECT_EQ(chosen(modems, "1"), "/modems/1");
    EXPECT_EQ(chosen(modems, "/modems/1"), "/modems/1");
    EXPECT_EQ(chosen(modems, "MODEL1"), "/modems/1");
    EXPECT_EQ(chosen(modems, "cdc-wdm1"), "/modems/1");
    EXPECT_EQ(chosen(modems, "2"), "none");
    EXPECT_EQ(chosen(modems, "model"), "none");
}

TEST(ModemName, HasNumberAndModel)
{
    EXPECT_EQ(modemName(modem("3", true, true)), "modem 3 (Model3)");
    EXPECT_EQ(modemName(ModemFacts()), "modem ");
}

} // namespace
} // namespace spectrel
