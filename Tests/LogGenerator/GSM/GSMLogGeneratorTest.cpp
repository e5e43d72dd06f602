#include "LogGenerator/GSM/GSMLogGenerator.h"

#include "LogGenerator/GeneratorSlot.h"
#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Values/PropertyList/PropertyList.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

/// A report of this content, in the XML form.
Bytes message(const Value& report)
{
    const std::string text = serialisePropertyList(report).value();
    return {text.begin(), text.end()};
}

Bytes bytes(std::string_view text)
{
    return {text.begin(), text.end()};
}

class GSMLogGeneratorTest : public testing::Test {
protected:
    GSMLogGeneratorTest()
    {
        log.takeLog();
    }
    void receive(const Bytes& body)
    {
        generator.updateState(state, body);
    }
    void report(const Value& content)
    {
        receive(message(content));
    }
    std::string display()
    {
        return displayText(state[StateKey::Display]);
    }

    FakeRunLoop time;
    LogRecorder log;
    Dictionary state;
    const Context context {.clock = time, .log = log};
    GSMLogGenerator generator {context};
};

TEST_F(GSMLogGeneratorTest, StartCommandOnlySetsTheState)
{
    EXPECT_EQ(displayText(generator.getStartCommand()), "{\"SetState\": \"Streaming\"}");
}

TEST_F(GSMLogGeneratorTest, CreationIsLoggedOnce)
{
    GSMLogGenerator::generator(context);
    const std::string text = log.takeLog();
    EXPECT_EQ(text.find("<4>Creating Log object: 0x"), 0u);
    EXPECT_EQ(text.find('\n'), text.size() - 1);
}

TEST_F(GSMLogGeneratorTest, DictionaryOfOneEntryGivesWayToItsValue)
{
    report(Dictionary::make({{"Cell", Dictionary::make({{"ARFCN", "12"}})}, {"Band", "900"}}));
    EXPECT_EQ(display(), "{\"Cell\": \"12\", \"Band\": \"900\"}");
}

TEST_F(GSMLogGeneratorTest, InnermostCollapsesFirstSoThatAWholeChainDoes)
{
    const auto chain = Dictionary::make({{"B", Dictionary::make({{"C", "x"}})}});
    report(Dictionary::make({{"A", chain}}));
    EXPECT_EQ(display(), "{\"A\": \"x\"}");
}

TEST_F(GSMLogGeneratorTest, TopLevelIsNotCollapsed)
{
    report(Dictionary::make({{"A", Dictionary::make({{"B", "1"}, {"C", "2"}})}}));
    EXPECT_EQ(display(), "{\"A\": {\"B\": \"1\", \"C\": \"2\"}}");
}

TEST_F(GSMLogGeneratorTest, EmptyAndLargerDictionariesStay)
{
    report(Dictionary::make({{"Empty", Dictionary::make()}, {"Two", Dictionary::make({{"a", "1"}, {"b", "2"}})}}));
    EXPECT_EQ(display(), "{\"Empty\": {}, \"Two\": {\"a\": \"1\", \"b\": \"2\"}}");
}

TEST_F(GSMLogGeneratorTest, ListLosesItsFirstElement)
{
    report(
        Dictionary::make({{"Three", List::make({"a", "b", "c"})}, {"One", List::make({"a"})}, {"None", List::make()}}));
    EXPECT_EQ(display(), "{\"Three\": [\"b\", \"c\"], \"One\": [], \"None\": []}");
}

TEST_F(GSMLogGeneratorTest, ElementsCollapseAndNestedListsLoseTheirFirstToo)
{
    report(List::make({"head", Dictionary::make({{"k", "x"}}), List::make({"1", "2"}),
        Dictionary::make({{"list", List::make({"p", "q"})}})}));
    EXPECT_EQ(display(), "[\"x\", [\"2\"], [\"q\"]]");
}

TEST_F(GSMLogGeneratorTest, TopLevelMayBeAText)
{
    report("all is well");
    EXPECT_EQ(display(), "\"all is well\"");
}

TEST_F(GSMLogGeneratorTest, BinaryFormIsReadAsWell)
{
    receive(
        bytes(std::string_view("bplist00\xD1\x01\x02\x51"
                               "A"
                               "\x51"
                               "x"
                               "\x08\x0B\x0D\0\0\0\0\0\0\x01\x01\0\0\0\0\0\0\0\x03\0\0\0\0\0\0\0\0\0\0\0\0\0\0\0\x0F",
            8 + 7 + 3 + 32)));
    EXPECT_EQ(display(), "{\"A\": \"x\"}");
}

TEST_F(GSMLogGeneratorTest, NumberAnywhereIsAnAssertionFailureAndLeftOut)
{
    report(Dictionary::make({{"a", "1"}, {"b", Value::integer(5)},
        {"c", List::make({"head", Value::integer(6), "x", Dictionary::make({{"d", Value::integer(7)}})})}}));
    EXPECT_EQ(display(), "{\"a\": \"1\", \"c\": [\"x\", {}]}");
    constexpr const char* Line =
        "<3>Unknown object of type integer encountered (LogGenerator/GSM/GSMLogGenerator:78)\n";
    EXPECT_EQ(log.takeLog(), std::string(Line) + Line + Line);
}

TEST_F(GSMLogGeneratorTest, EveryOtherTypeIsUnknown)
{
    report(List::make({"head", Value::real(0.5), Value::boolean(true), Date {0}, std::make_shared<const Bytes>(3)}));
    EXPECT_EQ(display(), "[]");
    EXPECT_EQ(log.takeLog(),
        "<3>Unknown object of type real encountered (LogGenerator/GSM/GSMLogGenerator:78)\n"
        "<3>Unknown object of type boolean encountered (LogGenerator/GSM/GSMLogGenerator:78)\n"
        "<3>Unknown object of type date encountered (LogGenerator/GSM/GSMLogGenerator:78)\n"
        "<3>Unknown object of type data encountered (LogGenerator/GSM/GSMLogGenerator:78)\n");
}

TEST_F(GSMLogGeneratorTest, FirstElementOfAListIsNotEvenLookedAt)
{
    report(List::make({Value::integer(5), "x"}));
    EXPECT_EQ(display(), "[\"x\"]");
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(GSMLogGeneratorTest, DictionaryLeftWithOneEntryCollapses)
{
    report(Dictionary::make({{"A", Dictionary::make({{"n", Value::integer(1)}, {"t", "x"}})}}));
    EXPECT_EQ(display(), "{\"A\": \"x\"}");
}

TEST_F(GSMLogGeneratorTest, TopLevelNumberLeavesNoDisplayAndKeepsTheReport)
{
    report(Value::integer(5));
    EXPECT_FALSE(state.contains(StateKey::Display));
    EXPECT_EQ(displayText(state[StateKey::DisplayState]), "int 5");
}

TEST_F(GSMLogGeneratorTest, MessageThatDoesNotParseIsAnAssertionFailureAndLeavesNoDisplay)
{
    report(Dictionary::make({{"A", "x"}}));
    receive(bytes("<plist><dict>"));
    EXPECT_EQ(log.takeLog(), "<3>Could not deserialize the object (LogGenerator/GSM/GSMLogGenerator:90)\n");
    EXPECT_FALSE(state.contains(StateKey::Display));
    EXPECT_FALSE(state.contains(StateKey::DisplayState));
    EXPECT_EQ(displayText(state[StateKey::ExtraInfo]), "{}");
    EXPECT_TRUE(generator.generateLogUsingState(state).isAbsent());
    EXPECT_EQ(displayText(state[StateKey::History]), "[{}]");
    report(Dictionary::make({{"A", "y"}}));
    EXPECT_EQ(display(), "{\"A\": \"y\"}");
}

TEST_F(GSMLogGeneratorTest, EmptyMessageDoesNotParse)
{
    receive({});
    EXPECT_EQ(log.takeLog(), "<3>Could not deserialize the object (LogGenerator/GSM/GSMLogGenerator:90)\n");
}

TEST_F(GSMLogGeneratorTest, BeforeTheFirstMessageThereIsNoDisplay)
{
    EXPECT_TRUE(generator.generateLogUsingState(state).isAbsent());
    EXPECT_EQ(state[StateKey::History].list()->count(), 1u);
}

TEST_F(GSMLogGeneratorTest, EachMessageReplacesEverything)
{
    report(Dictionary::make({{"A", "1"}, {"B", "2"}}));
    const auto first = state[StateKey::Display].dictionary();
    state[StateKey::ExtraInfo].dictionary()->set("x", "y");
    report(Dictionary::make({{"B", "3"}}));
    EXPECT_EQ(display(), "{\"B\": \"3\"}");
    EXPECT_EQ(displayText(first), "{\"A\": \"1\", \"B\": \"2\"}");
    EXPECT_EQ(displayText(state[StateKey::ExtraInfo]), "{}");
}

TEST_F(GSMLogGeneratorTest, HistoryKeepsTheReportAsReceivedAndIsSavedWithoutADLF)
{
    report(Dictionary::make({{"A", Dictionary::make({{"B", "x"}})}}));
    EXPECT_EQ(displayText(generator.generateLogUsingState(state)), "{\"A\": \"x\"}");
    const auto contents = generator.getSaveContentsFromState(state);
    EXPECT_EQ(displayText(contents),
        "[{\"DisplayState\": {\"A\": {\"B\": \"x\"}}, \"Display\": {\"A\": \"x\"}, \"ExtraInfo\": {}, "
        "\"Date\": \"2024-03-05 14:07:31 +0000\", \"Description\": \"Snapshot (2024-03-05 14:07:31 +0000)\"}]");
    EXPECT_NE(contents, state[StateKey::History].list()) << "a new list";
}

TEST_F(GSMLogGeneratorTest, WithoutHistoryNothingIsSaved)
{
    EXPECT_EQ(displayText(generator.getSaveContentsFromState(state)), "[]");
}

TEST_F(GSMLogGeneratorTest, OnlyDictionariesOfOneEntryCanCollapse)
{
    EXPECT_EQ(displayText(GSMLogGenerator::canCollapse(Dictionary::make({{"a", "x"}}))), "\"x\"");
    EXPECT_TRUE(GSMLogGenerator::canCollapse(Dictionary::make()).isAbsent());
    EXPECT_TRUE(GSMLogGenerator::canCollapse(Dictionary::make({{"a", "x"}, {"b", "y"}})).isAbsent());
    EXPECT_TRUE(GSMLogGenerator::canCollapse(List::make({"x"})).isAbsent());
    EXPECT_TRUE(GSMLogGenerator::canCollapse("x").isAbsent());
    EXPECT_TRUE(GSMLogGenerator::canCollapse(Value()).isAbsent());
}

TEST_F(GSMLogGeneratorTest, NewGeneratorTakesTheDisplayOverUntilTheNextMessage)
{
    GeneratorSlot slot;
    slot.replace(LogGenerator::generatorFromTechnology(kRKLogChannelTechnology_IFX, context), state, false);
    slot->updateState(state, message(Dictionary::make({{"A", "x"}})));
    slot.replace(LogGenerator::generatorFromTechnology(kRKLogChannelTechnology_IFX, context), state, true);
    EXPECT_EQ(display(), "{\"A\": \"x\"}");
    EXPECT_EQ(displayText(slot->generateLogUsingState(state)), "{\"A\": \"x\"}");
    EXPECT_EQ(state[StateKey::History].list()->count(), 1u) << "the waiting message has its one entry";
}

} // namespace
} // namespace spectrel
