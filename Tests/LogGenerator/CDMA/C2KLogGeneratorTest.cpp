#include "Tests/Fakes/SourceFolder.h"
#include "Tests/LogGenerator/CDMA/C2KFixture.h"

#include "LogGenerator/CDMA/Lookup.h"
#include "LogGenerator/GeneratorSlot.h"
#include "Records/TelephonyConstants.h"

#include <set>

namespace spectrel {
namespace {

/// A 0x1183 record with this channel, 0 to 255.
RecordBuilder channelRecord(std::uint8_t channel)
{
    return RecordBuilder(0x1183, 50).u8(13, channel);
}

class C2KLogGeneratorTest : public C2KFixture {
protected:
    C2KLogGeneratorTest()
        : C2KFixture({"kChannel", "kBandClass"})
    {
    }
    /// Begins anew with another template.
    void useTemplate(const Value& layout)
    {
        resources.lists["C2KTemplate"] = layout;
        for (const std::string_view key : {StateKey::Template, StateKey::Display, StateKey::Lookup})
            state.remove(key);
    }
    DataRef rawRecords()
    {
        generator.generateLogUsingState(state);
        return state[StateKey::DisplayState].data();
    }
};

TEST_F(C2KLogGeneratorTest, StartCommandAsksForTheEightCodesInTheirOrder)
{
    EXPECT_EQ(displayText(generator.getStartCommand()),
        "{\"SetState\": \"Streaming\", \"SetZephyrLogCodes\": [int 4234, int 4483, int 4498, int 4790, int 4508, "
        "int 4509, int 4734, int 4943]}");
}

TEST_F(C2KLogGeneratorTest, CreationIsLoggedOnce)
{
    C2KLogGenerator::generator(context);
    const std::string text = log.takeLog();
    EXPECT_EQ(text.find("<4>Creating Log object: 0x"), 0u);
    EXPECT_EQ(text.find('\n'), text.size() - 1);
}

TEST_F(C2KLogGeneratorTest, FirstCallOnAnEmptyStateAnswersTheNewDisplay)
{
    Dictionary empty;
    const Value display = generator.getDisplayFromState(empty);
    EXPECT_EQ(displayText(display), "{\"kChannel\": \"\", \"kBandClass\": \"\"}");
    EXPECT_EQ(display, generator.getDisplayFromState(empty));
    EXPECT_EQ(displayText(empty[StateKey::ExtraInfo]), "{}");
    EXPECT_EQ(displayText(empty[StateKey::Lookup]),
        "{\"kChannel\": [{\"key\": \"kChannel\", \"dict\": {\"kChannel\": \"\", \"kBandClass\": \"\"}}], "
        "\"kBandClass\": [{\"key\": \"kBandClass\", \"dict\": {\"kChannel\": \"\", \"kBandClass\": \"\"}}]}");
}

TEST_F(C2KLogGeneratorTest, VariableAtTwoPlacesIsShownAtBoth)
{
    useTemplate(Dictionary::make({{"Summary", Dictionary::make({{"Channel", "kChannel"}})},
        {"EV-DO", Dictionary::make({{"Radio", Dictionary::make({{"Ch", "kChannel"}})}})}}));
    deliver(channelRecord(37));
    EXPECT_EQ(display(), "{\"Summary\": {\"Channel\": \"37\"}, \"EV-DO\": {\"Radio\": {\"Ch\": \"37\"}}}");
}

TEST_F(C2KLogGeneratorTest, ListAtTwoPlacesIsOneAndTheSame)
{
    useTemplate(Dictionary::make({{"A", "kActiveSetPilots"}, {"B", "kActiveSetPilots"}}));
    deliver(RecordBuilder(0x12B6, 37).u8(15, 1));
    const auto& shownTwice = *state[StateKey::Display].dictionary();
    ASSERT_TRUE(shownTwice["A"].dictionary());
    EXPECT_EQ(shownTwice["A"].dictionary(), shownTwice["B"].dictionary());
}

TEST_F(C2KLogGeneratorTest, SortedMarkIsCopiedAndIsNoVariable)
{
    useTemplate(Dictionary::make({{"_sorted", "_sorted"}, {"1;Channel", "kChannel"}}));
    EXPECT_EQ(displayText(generator.getDisplayFromState(state)), "{\"_sorted\": \"_sorted\", \"1;Channel\": \"\"}");
    EXPECT_FALSE(state[StateKey::Lookup].dictionary()->contains("_sorted"));
}

TEST_F(C2KLogGeneratorTest, NumbersAndListsInATemplateAreNotCopied)
{
    useTemplate(Dictionary::make({{"Number", Value::integer(5)}, {"List", List::make({"kChannel"})},
        {"Truth", Value::boolean(true)}, {"Channel", "kChannel"}}));
    EXPECT_EQ(displayText(generator.getDisplayFromState(state)), "{\"Channel\": \"\"}");
}

TEST_F(C2KLogGeneratorTest, EachDictionaryOfTheTemplateIsLoggedAlsoAnEmptyOne)
{
    useTemplate(Dictionary::make({{"Empty", Dictionary::make()}, {"One", Dictionary::make({{"a", "kChannel"}})}}));
    generator.getDisplayFromState(state);
    constexpr const char* Line = "<4>Processing the template\n";
    EXPECT_EQ(log.takeLog(), std::string(Line) + Line + Line);
}

TEST_F(C2KLogGeneratorTest, MissingTemplateIsLoggedAndTriedAgainAtTheNextMessage)
{
    useTemplate(Value());
    state.remove(StateKey::ExtraInfo);
    deliver(channelRecord(37));
    deliver(RecordBuilder(0x1192, 241).u32(13, 5));
    constexpr const char* Line = "<3>Cannot load C2K template for display\n";
    EXPECT_EQ(log.takeLog(), std::string(Line) + Line);
    EXPECT_TRUE(generator.generateLogUsingState(state).isAbsent());
    resources.lists["C2KTemplate"] = Dictionary::make({{"Channel", "kChannel"}});
    deliver(channelRecord(38));
    EXPECT_EQ(display(), "{\"Channel\": \"38\"}");
}

TEST_F(C2KLogGeneratorTest, TemplateThatIsNoDictionaryCannotBeLoaded)
{
    useTemplate(List::make({"kChannel"}));
    EXPECT_TRUE(generator.getDisplayFromState(state).isAbsent());
    EXPECT_EQ(log.takeLog(), "<3>Cannot load C2K template for display\n");
}

TEST_F(C2KLogGeneratorTest, VariableThatTheTemplateDoesNotNameIsLost)
{
    useTemplate(Dictionary::make({{"Band", "kBandClass"}}));
    deliver(channelRecord(37));
    EXPECT_EQ(display(), "{\"Band\": \"800 MHz cellular band [0]\"}");
}

TEST_F(C2KLogGeneratorTest, MessageOfTwelveBytesIsIgnoredWithoutALine)
{
    deliver(RecordBuilder(0x1183, 50).shrink(12));
    deliver({});
    EXPECT_EQ(log.takeLog(), "");
    EXPECT_EQ(rawRecords()->size(), 0u);
}

TEST_F(C2KLogGeneratorTest, WrappedMessageOfThirteenBytesIsARecordOfEleven)
{
    deliver(RecordBuilder(0x1183, 13).shrink(11).wrap());
    EXPECT_EQ(log.takeLog(), "<3>Log code 0x1183 is 11 bytes long but should be 50 bytes.\n");
    EXPECT_EQ(rawRecords()->size(), 11u);
}

TEST_F(C2KLogGeneratorTest, WrapperIsTakenAwayBeforeDecodingAndKeeping)
{
    deliver(channelRecord(37).wrap());
    EXPECT_EQ(shown("kChannel"), "\"37\"");
    EXPECT_EQ(*rawRecords(), channelRecord(37).bytes());
}

TEST_F(C2KLogGeneratorTest, WrongTypeIsLoggedAndTheRecordStillDecodedAndKept)
{
    deliver(channelRecord(37).u8(0, 2));
    EXPECT_EQ(log.takeLog(), "<3>Invalid log type: 2. Dropping.\n");
    EXPECT_EQ(shown("kChannel"), "\"37\"");
    EXPECT_EQ(rawRecords()->size(), 50u);
}

TEST_F(C2KLogGeneratorTest, ExtraStreamIsAWrongTypeAndMatchesNoDecoder)
{
    deliver(channelRecord(37).u8(0, 0xFF));
    EXPECT_EQ(log.takeLog(), "<3>Invalid log type: ff. Dropping.\n");
    EXPECT_EQ(shown("kChannel"), "\"\"");
    EXPECT_EQ(rawRecords()->size(), 0u);
}

TEST_F(C2KLogGeneratorTest, UnknownCodeChangesNothingAndIsNotKept)
{
    const std::string before = display();
    deliver(RecordBuilder(0x1234, 50).u8(13, 37));
    EXPECT_EQ(display(), before);
    EXPECT_EQ(log.takeLog(), "");
    EXPECT_EQ(rawRecords()->size(), 0u);
}

TEST_F(C2KLogGeneratorTest, RefusedRecordOfAKnownCodeIsKept)
{
    deliver(RecordBuilder(0x1183, 49));
    EXPECT_EQ(rawRecords()->size(), 49u);
}

TEST_F(C2KLogGeneratorTest, RefreshHandsTheRecordsOverAndStartsAnew)
{
    deliver(channelRecord(1));
    deliver(channelRecord(2));
    EXPECT_EQ(rawRecords()->size(), 100u);
    EXPECT_EQ(rawRecords()->size(), 0u);
    EXPECT_EQ(state[StateKey::History].list()->count(), 2u);
}

TEST_F(C2KLogGeneratorTest, RefreshBeforeAnyMessageBuildsAndAnswersTheDisplay)
{
    Dictionary empty;
    EXPECT_EQ(displayText(generator.generateLogUsingState(empty)), "{\"kChannel\": \"\", \"kBandClass\": \"\"}");
}

TEST_F(C2KLogGeneratorTest, SavedContentsEndWithADLFOfTheRecords)
{
    deliver(channelRecord(1).wrap());
    generator.generateLogUsingState(state);
    const auto contents = generator.getSaveContentsFromState(state);
    ASSERT_EQ(contents->count(), 2u);
    const auto& last = *(*contents)[1].dictionary();
    EXPECT_EQ(last["Description"], Value("DLF binary (210 bytes)")); // 161 and a record without its type byte
    EXPECT_EQ(last["DLF"].data()->size(), 210u);
}

TEST(LookupTest, ValueIsLostWithoutALookupOrItsVariable)
{
    auto shown = Dictionary::make({{"a", "old"}});
    auto lookup = Dictionary::make({{"text", "no list"}});
    addLookupPosition(*lookup, "x", "a", shown);
    setLookupText("x", "new", Value());
    setLookupText("y", "new", lookup);
    setLookupText("text", "new", lookup);
    EXPECT_EQ(displayText(shown), "{\"a\": \"old\"}");
}

TEST(LookupTest, FirstPositionThatIsNoneEndsTheLoop)
{
    auto shown = Dictionary::make();
    const auto position = [](const Value& key, const Value& holder) {
        return Dictionary::make({{"key", key}, {"dict", holder}});
    };
    const std::initializer_list<Value> broken {
        position(Value::integer(1), shown), position("b", "no dictionary"), Dictionary::make(), "no position"};
    for (const Value& none : broken) {
        shown->removeAll();
        const Value lookup = Dictionary::make({{"x", List::make({position("a", shown), none, position("c", shown)})}});
        setLookupValue("x", "new", lookup);
        EXPECT_EQ(displayText(shown), "{\"a\": \"new\"}") << displayText(none);
    }
}

class C2KTakeoverTest : public C2KFixture {
protected:
    C2KTakeoverTest()
        : C2KFixture({"kChannel", "kFLDataRate"})
    {
        state.removeAll();
    }
    void use(std::string_view technology, bool hasUnbuiltMessages = false)
    {
        slot.replace(LogGenerator::generatorFromTechnology(technology, context), state, hasUnbuiltMessages);
    }
    GeneratorSlot slot;
};

TEST_F(C2KTakeoverTest, NewGeneratorGoesOnWithDisplayRunningValuesAndRecords)
{
    use(kRKLogChannelTechnology_Zephyr_CDMA);
    slot->updateState(state, channelRecord(37));
    slot->updateState(state, RecordBuilder(0x1192, 241).u32(13, 1));
    const auto shownBefore = state[StateKey::Display].dictionary();
    use(kRKLogChannelTechnology_Zephyr_CDMA, true);
    slot->updateState(state, RecordBuilder(0x1192, 241).u32(13, 2).u32(17, 8));
    EXPECT_EQ(state[StateKey::Display].dictionary(), shownBefore);
    EXPECT_EQ(display(), "{\"kChannel\": \"37\", \"kFLDataRate\": \"1.00 kbps\"}");
    slot->generateLogUsingState(state);
    EXPECT_EQ(state[StateKey::DisplayState].data()->size(), 50u + 241u + 241u);
}

TEST_F(C2KTakeoverTest, AnotherTechnologyFindsNeitherDisplayNorLookupAndTheHistoryStays)
{
    use(kRKLogChannelTechnology_Zephyr_CDMA);
    slot->updateState(state, channelRecord(37));
    use(kRKLogChannelTechnology_IFX, true);
    for (const std::string_view key : {StateKey::Template, StateKey::Display, StateKey::Lookup})
        EXPECT_FALSE(state.contains(key)) << key;
    EXPECT_EQ(state[StateKey::History].list()->count(), 1u);
    use(kRKLogChannelTechnology_Zephyr_CDMA);
    slot->updateState(state, channelRecord(38));
    EXPECT_EQ(display(), "{\"kChannel\": \"38\", \"kFLDataRate\": \"\"}");
}

/// Every text that stands as a leaf, the mark aside.
void collectLeaves(const Value& value, std::multiset<std::string>& leaves)
{
    if (const std::string* text = value.string(); text && *text != "_sorted")
        leaves.insert(*text);
    if (const auto& dictionary = value.dictionary()) {
        for (const auto& entry : dictionary->entries())
            collectLeaves(entry.value, leaves);
    }
}

TEST(C2KTemplateTest, ShippedTemplateShowsEveryVariableAndNothingElse)
{
    const DirectoryResources shipped(sourcePath("Resources"));
    const auto layout = shipped.propertyList("C2KTemplate");
    ASSERT_TRUE(layout);
    std::multiset<std::string> leaves;
    collectLeaves(*layout, leaves);
    const std::set<std::string> variables {"kChannel", "k1xEVDODeviceState", "kBandClass", "kRxAGC0", "kRxAGC1",
        "kTxAGC", "kServingPNOffset", "kSessionState", "kUATI24", "kColorCode", "kActiveSetPilots", "kFingerC2I",
        "k1xDeviceState", "k1xRx0BandClass", "k1xRx0ChanNum", "k1xRxAGC0", "k1xRx1BandClass", "k1xRx1ChanNum",
        "k1xRxAGC1", "k1xTxAGC", "k1xActiveSetInfo", "k1xTrafficFER", "kFLDataRate", "kRLDataRate", "k1xRoamingHome",
        "kSystemId", "kNetworkId", "kPacketZoneId", "kBaseId", "kProtocolRevision"};
    EXPECT_EQ(std::set<std::string>(leaves.begin(), leaves.end()), variables);
    EXPECT_GT(leaves.size(), variables.size()) << "some stand in the summary, too";
}

} // namespace
} // namespace spectrel
