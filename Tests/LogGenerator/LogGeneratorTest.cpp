#include "LogGenerator/LogGenerator.h"

#include "LogGenerator/GeneratorSlot.h"
#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

class HistoryTest : public testing::Test {
protected:
    void fillState()
    {
        state.set(StateKey::DisplayState, DataRef(std::make_shared<Bytes>(Bytes {1, 2})));
        state.set(StateKey::Display, display);
        state.set(StateKey::ExtraInfo, Dictionary::make());
    }
    void fillHistory(int count)
    {
        auto entries = List::make();
        for (int number = 0; number < count; ++number)
            entries->append(Dictionary::make({{"Number", std::to_string(number)}}));
        state.set(StateKey::History, entries);
    }
    const List& history()
    {
        return *state[StateKey::History].list();
    }
    std::string numberAt(std::size_t position)
    {
        return displayText((*history()[position].dictionary())["Number"]);
    }

    FakeRunLoop time;
    LogRecorder log;
    Dictionary state;
    DictionaryRef display = Dictionary::make({{"Cell", "1"}});
};

TEST_F(HistoryTest, StateWithoutHistoryGainsOneEntry)
{
    fillState();
    LogGenerator::updateHistoryInState(state, time);
    ASSERT_EQ(history().count(), 1u);
    EXPECT_EQ(displayText(history()[0]),
        "{\"DisplayState\": data 0102, \"Display\": {\"Cell\": \"1\"}, \"ExtraInfo\": {}, "
        "\"Date\": \"2024-03-05 14:07:31 +0000\", \"Description\": \"Snapshot (2024-03-05 14:07:31 +0000)\"}");
}

TEST_F(HistoryTest, FourEntriesGainAFifthWithoutLosingAny)
{
    fillHistory(4);
    fillState();
    LogGenerator::updateHistoryInState(state, time);
    EXPECT_EQ(history().count(), 5u);
    EXPECT_EQ(numberAt(0), "\"0\"");
}

TEST_F(HistoryTest, FiveEntriesLoseTheOldestForTheNewOne)
{
    fillHistory(5);
    fillState();
    LogGenerator::updateHistoryInState(state, time);
    EXPECT_EQ(history().count(), 5u);
    EXPECT_EQ(numberAt(0), "\"1\"");
}

TEST_F(HistoryTest, NineEntriesAreCutToTheNewestFourAndTheNewOne)
{
    fillHistory(9);
    fillState();
    LogGenerator::updateHistoryInState(state, time);
    EXPECT_EQ(history().count(), 5u);
    EXPECT_EQ(numberAt(0), "\"5\"");
    EXPECT_EQ(numberAt(3), "\"8\"");
    EXPECT_EQ(numberAt(4), "none");
}

TEST_F(HistoryTest, AbsentDisplayStateAppendsAnEmptyEntry)
{
    fillState();
    state.remove(StateKey::DisplayState);
    LogGenerator::updateHistoryInState(state, time);
    EXPECT_EQ(displayText(history()[0]), "{}");
}

TEST_F(HistoryTest, AbsentDisplayEndsTheEntryAfterDisplayState)
{
    fillState();
    state.remove(StateKey::Display);
    LogGenerator::updateHistoryInState(state, time);
    EXPECT_EQ(displayText(history()[0]), "{\"DisplayState\": data 0102}");
}

TEST_F(HistoryTest, AbsentExtraInfoEndsTheEntryAfterDisplay)
{
    fillState();
    state.remove(StateKey::ExtraInfo);
    LogGenerator::updateHistoryInState(state, time);
    EXPECT_EQ(displayText(history()[0]), "{\"DisplayState\": data 0102, \"Display\": {\"Cell\": \"1\"}}");
}

TEST_F(HistoryTest, OnlyTheTopLevelOfTheDisplayIsCopied)
{
    auto nested = Dictionary::make({{"RSRP", "-90"}});
    display->set("Nested", nested);
    fillState();
    LogGenerator::updateHistoryInState(state, time);
    display->set("Cell", "2");
    nested->set("RSRP", "-80");
    const auto& kept = (*history()[0].dictionary())["Display"];
    EXPECT_EQ(displayText(kept), "{\"Cell\": \"1\", \"Nested\": {\"RSRP\": \"-80\"}}");
}

class TechnologyTest : public testing::Test {
protected:
    std::string generatorFor(const Value& technology)
    {
        const auto generator = LogGenerator::generatorFromTechnology(technology, context);
        return generator ? std::string(generator->className()) : "none";
    }
    LogRecorder log;
    FakeResources resources;
    const Context context {.resources = resources, .log = log, .console = log};
};

TEST_F(TechnologyTest, EachKnownTechnologyHasItsGenerator)
{
    EXPECT_EQ(generatorFor(kRKLogChannelTechnology_Zephyr_LTE), "LTELogGenerator");
    EXPECT_EQ(generatorFor(kRKLogChannelTechnology_Zephyr_GSM), "ZPH_GSMLogGenerator");
    EXPECT_EQ(generatorFor(kRKLogChannelTechnology_Zephyr_UTRAN2), "UTRANLogGenerator");
    EXPECT_EQ(generatorFor(kRKLogChannelTechnology_Zephyr_CDMA), "C2KLogGenerator");
    EXPECT_EQ(generatorFor(kRKLogChannelTechnology_IFX), "GSMLogGenerator");
}

TEST_F(TechnologyTest, UnknownTechnologyHasNoGenerator)
{
    EXPECT_EQ(generatorFor("kRKLogChannelTechnology_Zephyr_NR"), "none");
}

TEST_F(TechnologyTest, NumberHasNoGenerator)
{
    EXPECT_EQ(generatorFor(Value::integer(3)), "none");
}

TEST_F(TechnologyTest, CreationIsLoggedInOrder)
{
    log.takeLog();
    const auto generator = LogGenerator::generatorFromTechnology(kRKLogChannelTechnology_Zephyr_LTE, context);
    const std::string text = log.takeLog();
    const auto created = text.find("<3>Creating LTELogGenerator object\n");
    const auto withIndex = text.find("<3>Creating ZPHLogGenerator2 object with 0x");
    const auto object = text.find("<4>Creating Log object: 0x");
    const auto index = text.find("<3>Class Index: 1\n");
    EXPECT_EQ(created, 0u);
    EXPECT_LT(created, withIndex);
    EXPECT_LT(withIndex, object);
    EXPECT_LT(object, index);
    EXPECT_NE(index, std::string::npos);
}

TEST_F(TechnologyTest, DestructionIsLoggedByTheClassAndItsBase)
{
    LogGenerator::generatorFromTechnology(kRKLogChannelTechnology_Zephyr_LTE, context);
    std::string text = log.takeLogWith("destructed");
    EXPECT_EQ(text.find("<4>LTELogGenerator is destructed 0x"), 0u);
    EXPECT_NE(text.find("\n<4>ZPH_GSMLogGenerator is destructed 0x"), std::string::npos);
    EXPECT_EQ(log.takeConsole(), "Deallocing LTEClassIndex\nDeallocing ClassIndex\n");

    LogGenerator::generatorFromTechnology(kRKLogChannelTechnology_Zephyr_GSM, context);
    text = log.takeLogWith("ZPH_GSMLogGenerator is destructed");
    EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 2);
}

class GeneratorSlotTest : public testing::Test {
protected:
    GeneratorSlotTest()
    {
        resources.lists["LTE"] = Dictionary::make({{"SIM Info", Dictionary::make({{"EF-ICCID", "-"}})}});
        resources.lists["ZPH_GSM"] = Dictionary::make({{"PDP Context Info", List::make()}});
    }
    void use(std::string_view technology, bool hasUnbuiltMessages = false)
    {
        slot.replace(LogGenerator::generatorFromTechnology(technology, context), state, hasUnbuiltMessages);
    }
    void receive()
    {
        const Bytes message(13, 0x01);
        slot->updateState(state, message);
    }

    FakeRunLoop time;
    LogRecorder log;
    FakeResources resources;
    const Context context {.resources = resources, .log = log, .console = log};
    Dictionary state;
    GeneratorSlot slot;
};

TEST_F(GeneratorSlotTest, NewGeneratorOfTheSameClassTakesTheDisplayOver)
{
    use(kRKLogChannelTechnology_Zephyr_LTE);
    receive();
    const auto display = state[StateKey::Display].dictionary();
    log.takeLog();
    use(kRKLogChannelTechnology_Zephyr_LTE);
    EXPECT_EQ(log.takeLogWith("<4>SIM Info"), "<4>SIM Info\n") << "the section was bound to the node that is there";
    receive();
    EXPECT_EQ(state[StateKey::Display].dictionary(), display);
    slot->generateLogUsingState(state);
    EXPECT_EQ(state[StateKey::DisplayState].data()->size(), 26u) << "the messages of both generators";
}

TEST_F(GeneratorSlotTest, GeneratorOfAnotherClassFindsAnEmptyDisplay)
{
    use(kRKLogChannelTechnology_Zephyr_LTE);
    receive();
    use(kRKLogChannelTechnology_Zephyr_GSM, true);
    EXPECT_FALSE(state.contains(StateKey::Display));
    EXPECT_FALSE(state.contains(StateKey::Template));
    ASSERT_EQ(state[StateKey::History].list()->count(), 1u) << "the messages not built yet got a last entry";
    receive();
    EXPECT_EQ(displayText(state[StateKey::Display]), "{\"PDP Context Info\": []}");
}

TEST_F(GeneratorSlotTest, DisplaySurvivesASpellWithoutAGenerator)
{
    use(kRKLogChannelTechnology_Zephyr_LTE);
    receive();
    const auto display = state[StateKey::Display].dictionary();
    use("nonsense", true);
    EXPECT_FALSE(slot);
    EXPECT_EQ(state[StateKey::History].list()->count(), 1u);
    use(kRKLogChannelTechnology_Zephyr_LTE);
    EXPECT_EQ(state[StateKey::Display].dictionary(), display);
}

} // namespace
} // namespace spectrel
