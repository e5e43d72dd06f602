#include "Telephony/Modem/ModemChoice.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

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
