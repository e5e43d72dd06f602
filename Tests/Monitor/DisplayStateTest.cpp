#include "Monitor/DisplayState.h"

#include "Records/TelephonyConstants.h"
#include "Tests/Fakes/FakeResources.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <string>

namespace spectrel {
namespace {

/// Writes down what each message has changed.
class Listener final : public JournalReader {
public:
    void messageApplied(const AppliedMessage& message, const Journal& journal) override
    {
        text += std::to_string(message.number) + "@" + std::to_string(message.time.time_since_epoch().count()) + ":";
        for (const Journal::Change& change : journal.changes())
            text += " " + journal.pathOf(change) + "=" + std::string(journal.valueOf(change));
        text += "\n";
    }
    std::string text;
};

class DisplayStateTest : public testing::Test {
protected:
    DisplayStateTest()
    {
        display.useTechnology(kRKLogChannelTechnology_IFX);
    }
    /// A report that is the whole display.
    void apply(const DictionaryRef& report, std::int64_t microseconds)
    {
        const std::string body = *serialisePropertyList(report);
        display.apply({reinterpret_cast<const std::uint8_t*>(body.data()), body.size()},
            Moment(std::chrono::microseconds(microseconds)));
    }

    LogRecorder log;
    FakeResources resources;
    const Context context {.resources = resources, .log = log, .console = log};
    DisplayState display {&LogGenerator::generatorFromTechnology, context};
    Listener listener;
};

TEST_F(DisplayStateTest, ReaderHearsOfEachMessageWithItsNumberTimeAndChanges)
{
    apply(Dictionary::make({{"A", "0"}, {"B", "2"}}), 3);
    display.addReader(listener);
    apply(Dictionary::make({{"A", "1"}, {"B", "2"}}), 5);
    apply(Dictionary::make({{"A", "1"}}), 8);
    EXPECT_EQ(listener.text, "1@5: /A=0 /B=2 /A=1 /B=2\n2@8: /A=1 /B=2\n");
    display.removeReader(listener);
    apply(Dictionary::make({{"A", "2"}}), 9);
    EXPECT_EQ(std::ranges::count(listener.text, '\n'), 2);
}

TEST_F(DisplayStateTest, NothingIsFollowedUntilSomebodyListens)
{
    apply(Dictionary::make({{"A", "1"}}), 1);
    EXPECT_EQ(display.state().observer(), nullptr);
    EXPECT_EQ(display.display().dictionary()->observer(), nullptr);
    display.followChanges();
    EXPECT_NE(display.display().dictionary()->observer(), nullptr);
}

TEST_F(DisplayStateTest, GeneratorsComeFromTheFactory)
{
    std::string asked;
    DisplayState other(
        [&asked](const Value& technology, const Context& given) {
            asked += *technology.string() + " ";
            return *technology.string() == "ours"
                ? LogGenerator::generatorFromTechnology(kRKLogChannelTechnology_IFX, given)
                : nullptr;
        },
        context);
    other.useTechnology("ours");
    EXPECT_EQ(other.generator()->className(), "GSMLogGenerator");
    other.useTechnology("theirs");
    EXPECT_EQ(other.generator(), nullptr);
    EXPECT_EQ(asked, "ours theirs ");
}

TEST_F(DisplayStateTest, NewsAreTakenOnce)
{
    EXPECT_FALSE(display.takeNews());
    apply(Dictionary::make({{"A", "1"}}), 1);
    EXPECT_TRUE(display.takeNews());
    EXPECT_FALSE(display.takeNews());
}

TEST_F(DisplayStateTest, GeneratorOfTheSameClassGoesOnWhereAsked)
{
    const LogGenerator* const first = display.generator();
    display.useTechnology(kRKLogChannelTechnology_IFX, DisplayState::SameClass::GoesOn);
    EXPECT_EQ(display.generator(), first);
    display.useTechnology("another");
    EXPECT_EQ(display.generator(), nullptr);
    EXPECT_EQ(display.saveContents(), nullptr);
    EXPECT_EQ(display.lastContents(), nullptr);
}

} // namespace
} // namespace spectrel
