#include "LogGenerator/Template/ZPHLogGenerator2.h"

#include "LogGenerator/Template/Base.h"
#include "Tests/Fakes/DisplayText.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/FakeRunLoop.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/RecordBuilder.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

/// Counts its records and writes their size and code into its node.
class Counter final : public Base {
public:
    Counter(const Context& context, ClassDictionary& dict, CodeDictionary& codeDict)
        : Base(context)
    {
        enterInto(dict, codeDict);
    }
    std::string_view getSectionName() const override
    {
        return "Counter";
    }
    std::vector<std::uint32_t> getLogCodeArray() const override
    {
        return {0xB0C2, 0xFF0000 + 0x0C00};
    }
    void updateWithData(RecordView record, std::uint32_t logCode) override
    {
        storeText("Size", std::to_string(record.size()));
        storeText("Code", std::to_string(logCode));
    }
};

class CounterIndex final : public ClassIndex {
public:
    using ClassIndex::ClassIndex;

private:
    Counter objCounter {context, classDict, codeDictionary};
};

class CounterGenerator final : public ZPHLogGenerator2 {
public:
    explicit CounterGenerator(const Context& context)
        : ZPHLogGenerator2(context)
    {
        initWithPListName("Counters", std::make_shared<CounterIndex>(context));
    }
    std::string_view className() const override
    {
        return "CounterGenerator";
    }
};

class TemplateGeneratorTest : public testing::Test {
protected:
    TemplateGeneratorTest()
    {
        resources.lists["Counters"] = Dictionary::make({
            {"Counter", Dictionary::make({{"Size", "-"}, {"Code", "-"}})},
            {"Plain", List::make({"text", Dictionary::make({{"Inner", "-"}})})},
        });
        log.takeLog();
    }
    void receive(ByteView message)
    {
        generator.updateState(state, message);
    }
    std::string counter()
    {
        return displayText((*state[StateKey::Display].dictionary())["Counter"]);
    }
    std::size_t rawBytes()
    {
        generator.generateLogUsingState(state);
        return state[StateKey::DisplayState].data()->size();
    }

    FakeRunLoop time;
    LogRecorder log;
    FakeResources resources;
    Dictionary state;
    const Context context {time, resources, log, log};
    CounterGenerator generator {context};
};

constexpr const char* Untouched = "{\"Size\": \"-\", \"Code\": \"-\"}";

TEST_F(TemplateGeneratorTest, MessageOfTwelveBytesIsDroppedWithoutALine)
{
    receive(RecordBuilder(0xB0C2, 13));
    const std::string before = counter();
    log.takeLog();
    receive(RecordBuilder(0xB0C2, 14).shrink(12));
    EXPECT_EQ(counter(), before);
    EXPECT_EQ(log.takeLog(), "");
}

TEST_F(TemplateGeneratorTest, WrappedMessageOfThirteenBytesIsRoutedAsARecordOfEleven)
{
    receive(RecordBuilder(0xB0C2, 13).shrink(11).wrap());
    EXPECT_EQ(counter(), "{\"Size\": \"11\", \"Code\": \"45250\"}");
}

TEST_F(TemplateGeneratorTest, InvalidTypeIsLoggedReachesNoSectionAndIsKept)
{
    receive(RecordBuilder(0xB0C2, 20).u8(0, 0x10));
    EXPECT_EQ(counter(), Untouched);
    EXPECT_EQ(log.takeLogWith("Invalid"), "<3>Invalid log type: 10. Dropping.\n");
    EXPECT_EQ(rawBytes(), 20u);
}

TEST_F(TemplateGeneratorTest, ExtraStreamIsRoutedWithItsOffset)
{
    receive(RecordBuilder(0xFF0000 + 0x0C00, 13));
    EXPECT_EQ(counter(), "{\"Size\": \"13\", \"Code\": \"16714752\"}");
}

TEST_F(TemplateGeneratorTest, CodeWithoutSubscribersChangesNothing)
{
    receive(RecordBuilder(0xB0C3, 20));
    EXPECT_EQ(counter(), Untouched);
}

TEST_F(TemplateGeneratorTest, StartCommandSplitsTheStreams)
{
    EXPECT_EQ(displayText(generator.getStartCommand()),
        "{\"SetState\": \"Streaming\", \"SetZephyrLogCodes\": [int 45250], \"SetRkExtraCodes\": [int 3072]}");
}

TEST_F(TemplateGeneratorTest, FirstCallBuildsTheDisplayAndAnswersNothingTheSecondAnswersIt)
{
    EXPECT_TRUE(generator.getDisplayFromState(state).isAbsent());
    EXPECT_TRUE(state.contains(StateKey::Template));
    EXPECT_TRUE(state.contains(StateKey::Display));
    EXPECT_EQ(displayText(state[StateKey::ExtraInfo]), "{}");
    EXPECT_EQ(displayText(generator.getDisplayFromState(state)),
        "{\"Counter\": {\"Size\": \"-\", \"Code\": \"-\"}, \"Plain\": [\"text\", {\"Inner\": \"-\"}]}");
}

TEST_F(TemplateGeneratorTest, BuildingTheDisplayIsLogged)
{
    generator.getDisplayFromState(state);
    const std::string text = log.takeLog();
    EXPECT_EQ(text.find("<4>Initialized class index: 0x"), 0u);
    EXPECT_NE(text.find("\n<4>Dictionary = 1\n<4>String = 0\n<4>Counter\n"), std::string::npos);
}

TEST_F(TemplateGeneratorTest, KeyThatNamesNoSectionIsCopiedAndNobodyIsTold)
{
    generator.getDisplayFromState(state);
    EXPECT_EQ(log.takeLogWith("Plain"), "");
    const auto& original = *resources.lists["Counters"].dictionary();
    const auto& copy = *state[StateKey::Display].dictionary();
    EXPECT_EQ(original["Plain"], copy["Plain"]);
    EXPECT_NE(original["Plain"].list(), copy["Plain"].list());
}

TEST_F(TemplateGeneratorTest, TemplateIsLoadedOnceAndUnchangedByTheSections)
{
    receive(RecordBuilder(0xB0C2, 13));
    EXPECT_EQ(displayText((*state[StateKey::Template].dictionary())["Counter"]), Untouched);
    resources.lists.clear();
    state.remove(StateKey::Display);
    receive(RecordBuilder(0xB0C2, 14));
    EXPECT_EQ(counter(), "{\"Size\": \"14\", \"Code\": \"45250\"}") << "rebuilt from the state's own template";
}

TEST_F(TemplateGeneratorTest, MissingTemplateIsLoggedAndTriedAgainAtTheNextMessage)
{
    resources.lists["Counters"] = Value();
    receive(RecordBuilder(0xB0C2, 13));
    EXPECT_EQ(log.takeLog(), "<3>Cannot load template for display\n");
    EXPECT_FALSE(state.contains(StateKey::Display));
    resources.lists["Counters"] = Dictionary::make({{"Counter", Dictionary::make()}});
    receive(RecordBuilder(0xB0C2, 13));
    EXPECT_EQ(counter(), "{\"Size\": \"13\", \"Code\": \"45250\"}");
}

TEST_F(TemplateGeneratorTest, TemplateThatIsNoDictionaryCannotBeLoaded)
{
    resources.lists["Counters"] = List::make({"x"});
    receive(RecordBuilder(0xB0C2, 13));
    EXPECT_EQ(log.takeLog(), "<3>Cannot load template for display\n");
}

TEST_F(TemplateGeneratorTest, OtherTypesInATemplateAreLoggedAndLeftOut)
{
    resources.lists["Counters"] =
        Dictionary::make({{"Counter", Value::integer(5)}, {"List", List::make({Value::real(0.5), "text"})}});
    generator.getDisplayFromState(state);
    EXPECT_EQ(displayText(state[StateKey::Display]), "{\"List\": [\"text\"]}");
    constexpr const char* Pair = "<3>Received an object of unknown type\n<4>Processing the template\n";
    EXPECT_EQ(log.takeLogWith(" the "), "<4>Processing the template\n<4>Processing the template\n");
    generator.processTemplate(Value::boolean(true));
    EXPECT_EQ(log.takeLog(), Pair);
}

TEST_F(TemplateGeneratorTest, SectionWhoseNodeIsATextLosesItsWrites)
{
    resources.lists["Counters"] = Dictionary::make({{"Counter", "text"}});
    receive(RecordBuilder(0xB0C2, 13));
    EXPECT_EQ(displayText(state[StateKey::Display]), "{\"Counter\": \"text\"}");
}

TEST_F(TemplateGeneratorTest, PrintDictLogsOnlyWhatItDoesNotKnow)
{
    generator.printDict(Dictionary::make({{"a", List::make({"x", Value::integer(1)})}, {"b", "y"}}));
    EXPECT_EQ(log.takeLog(), "<3>Received an object of unknown type\n");
}

TEST_F(TemplateGeneratorTest, RefreshHandsTheRawMessagesOverAsReceivedAndStartsAnew)
{
    receive(RecordBuilder(0xB0C2, 13).wrap());
    receive(RecordBuilder(0xB0C2, 13).shrink(5));
    EXPECT_EQ(rawBytes(), 20u);
    EXPECT_EQ(rawBytes(), 0u);
    EXPECT_EQ(state[StateKey::History].list()->count(), 2u);
}

TEST_F(TemplateGeneratorTest, EmptyMessageHarmsNothing)
{
    receive({});
    EXPECT_EQ(counter(), Untouched);
}

} // namespace
} // namespace spectrel
