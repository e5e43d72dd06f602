#include "CommandLine/Output/DisplayChanges.h"

#include "LogGenerator/LogGenerator.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

class DisplayChangesTest : public testing::Test {
protected:
    std::string update(const Value& display)
    {
        state->set(StateKey::Display, display);
        journal.finishMessage();
        std::string text;
        changes.update(
            (*state)[StateKey::Display], journal, [&text](const std::string& path, const std::string* value) {
                text += path + (value ? "=" + *value : " gone") + "\n";
            });
        return text;
    }
    /// The display of so many keys, in their order or the other way round.
    static DictionaryRef numbered(int count, bool isReversed)
    {
        auto display = Dictionary::make();
        for (int index = 0; index < count; ++index)
            display->set(std::to_string(isReversed ? count - index : index + 1), "x");
        return display;
    }

    const DictionaryRef state = Dictionary::make();
    Journal journal {state};
    DisplayChanges changes;
};

TEST_F(DisplayChangesTest, FirstDisplayIsAllNew)
{
    EXPECT_EQ(update(Dictionary::make({{"A", "1"}, {"B", List::make({"x", Dictionary::make({{"k", "v"}})})}})),
        "/A=1\n/B/0=x\n/B/1/k=v\n");
}

TEST_F(DisplayChangesTest, SameDisplayChangesNothing)
{
    const auto display = Dictionary::make({{"A", "1"}, {"B", List::make({"x"})}});
    update(display);
    EXPECT_EQ(update(display), "");
}

TEST_F(DisplayChangesTest, OnlyTheChangedLeafIsTold)
{
    const auto display = Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}});
    update(display);
    display->setText("B", "9");
    EXPECT_EQ(update(display), "/B=9\n");
}

TEST_F(DisplayChangesTest, RemovedAndAppendedKeyIsToldOnce)
{
    const auto display = Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}});
    update(display);
    display->remove("A");
    EXPECT_EQ(update(display), "/A gone\n");
    display->setText("A", "1");
    EXPECT_EQ(update(display), "/A=1\n");
}

TEST_F(DisplayChangesTest, PathThatAnotherLeafStillHasIsNotGone)
{
    update(Dictionary::make({{"_sorted", ""}, {"1;X", "a"}, {"2;X", "b"}, {"3;Y", "c"}}));
    EXPECT_EQ(update(Dictionary::make({{"_sorted", ""}, {"1;X", "b"}, {"3;Y", "c"}})), "/X=b\n");
    EXPECT_EQ(update(Dictionary::make({{"_sorted", ""}, {"3;Y", "c"}})), "/X gone\n");
}

TEST_F(DisplayChangesTest, OrderAloneIsNoChange)
{
    update(Dictionary::make({{"A", "1"}, {"B", "2"}, {"C", "3"}}));
    EXPECT_EQ(update(Dictionary::make({{"C", "3"}, {"A", "1"}, {"B", "2"}})), "");
}

TEST_F(DisplayChangesTest, OfLeavesAtOnePathTheLastIsToldLast)
{
    const auto fingers = [](const Value& first, const Value& second, const Value& third) {
        return Dictionary::make({{"_sorted", "_sorted"}, {"0;12", first}, {"1;4", second}, {"2;12", third}});
    };
    EXPECT_EQ(update(fingers("a", "b", "c")), "/12=a\n/4=b\n/12=c\n");
    EXPECT_EQ(update(fingers("a", "b", "c")), "");
    EXPECT_EQ(update(fingers("a", "b", "C")), "/12=C\n");
    EXPECT_EQ(update(fingers("A", "b", "C")), "/12=A\n/12=C\n");
    EXPECT_EQ(update(fingers("A", "B", "C")), "/4=B\n");
}

TEST_F(DisplayChangesTest, LeafIsNotGoneWhileAnotherStandsAtItsPath)
{
    const auto fingers = [](const Value& first, const Value& second) {
        return Dictionary::make({{"_sorted", "_sorted"}, {"0;12", first}, {"1;4", "b"}, {"2;12", second}});
    };
    update(fingers("a", "c"));
    EXPECT_EQ(update(fingers("a", {})), "/12=a\n");
    update(fingers("a", "c"));
    EXPECT_EQ(update(fingers({}, "c")), "/12=c\n");
    EXPECT_EQ(update(fingers({}, {})), "/12 gone\n");
    update(fingers("a", "c"));
    EXPECT_EQ(update(fingers({}, {})), "/12 gone\n/12 gone\n");
    update(fingers("a", "c"));
    EXPECT_EQ(update(fingers("a", List::make({"x"}))), "/12 gone\n/12/0=x\n");
    EXPECT_EQ(update(fingers("a", {})), "/12=a\n/12/0 gone\n");
}

TEST_F(DisplayChangesTest, ShorterListLosesItsLastElements)
{
    update(List::make({Dictionary::make({{"k", "1"}}), Dictionary::make({{"k", "2"}, {"l", "3"}})}));
    EXPECT_EQ(update(List::make({Dictionary::make({{"k", "1"}})})), "/1/k gone\n/1/l gone\n");
}

TEST_F(DisplayChangesTest, LeafThatBecomesAContainerGoesAndComesAgain)
{
    update(Dictionary::make({{"A", "1"}}));
    EXPECT_EQ(update(Dictionary::make({{"A", List::make({"x"})}})), "/A gone\n/A/0=x\n");
    EXPECT_EQ(update(Dictionary::make({{"A", "1"}})), "/A/0 gone\n/A=1\n");
}

TEST_F(DisplayChangesTest, DisplayThatGoesTakesItsLeavesAlong)
{
    EXPECT_EQ(update({}), "");
    update(Dictionary::make({{"A", "1"}}));
    EXPECT_EQ(update({}), "/A gone\n");
    EXPECT_EQ(update(Dictionary::make({{"A", "1"}})), "/A=1\n");
}

TEST_F(DisplayChangesTest, DisplayThatIsATextIsTheRootLeaf)
{
    EXPECT_EQ(update("text"), "/=text\n");
    EXPECT_EQ(update("other"), "/=other\n");
}

TEST_F(DisplayChangesTest, ContainersThatHaveNotChangedAreNotLookedInto)
{
    const auto changing = Dictionary::make({{"a", "1"}, {"b", "2"}});
    const auto display = Dictionary::make({{"Large", numbered(1000, false)}, {"Small", changing}});
    update(display);
    const std::uint64_t before = changes.comparisons();
    changing->setText("a", "1");
    EXPECT_EQ(update(display), "");
    EXPECT_EQ(changes.comparisons(), before);
    changing->setText("b", "3");
    EXPECT_EQ(update(display), "/Small/b=3\n");
    EXPECT_EQ(changes.comparisons(), before + 4);
}

TEST_F(DisplayChangesTest, ContainerAtTwoPlacesChangesAtBoth)
{
    const auto shared = Dictionary::make({{"a", "1"}});
    const auto display = Dictionary::make({{"X", shared}, {"Y", Dictionary::make({{"Z", shared}})}});
    update(display);
    shared->setText("a", "2");
    EXPECT_EQ(update(display), "/X/a=2\n/Y/Z/a=2\n");
    display->set("X", "text");
    shared->setText("a", "3");
    EXPECT_EQ(update(display), "/X/a gone\n/X=text\n/Y/Z/a=3\n");
}

TEST_F(DisplayChangesTest, ReorderedKeysCostAFewComparisonsEach)
{
    constexpr int Keys = 20000;
    for (int message = 0; message < 4; ++message) {
        const std::uint64_t before = changes.comparisons();
        EXPECT_EQ(update(numbered(Keys, message % 2 == 1)).empty(), message > 0);
        EXPECT_LE(changes.comparisons() - before, 4 * Keys);
    }
}

TEST_F(DisplayChangesTest, OnlyChosenLeavesAreReported)
{
    changes = DisplayChanges(PathChoice({"/A/*", "**/z"}));
    const auto inner = Dictionary::make({{"x", "1"}, {"y", "2"}});
    const auto display = Dictionary::make({{"A", inner}, {"B", Dictionary::make({{"x", "3"}, {"z", "4"}})}});
    EXPECT_EQ(update(display), "/A/x=1\n/A/y=2\n/B/z=4\n");
    inner->setText("x", "9");
    display->setText("C", "new");
    EXPECT_EQ(update(display), "/A/x=9\n");
    display->set("A", "leaf"); // which no glob chooses
    EXPECT_EQ(update(display), "/A/x gone\n/A/y gone\n");
    display->set("A", Dictionary::make({{"x", "7"}}));
    EXPECT_EQ(update(display), "/A/x=7\n");
    display->remove("B");
    EXPECT_EQ(update(display), "/B/z gone\n");
    EXPECT_EQ(update({}), "/A/x gone\n");
    EXPECT_EQ(update(display), "/A/x=7\n");
}

} // namespace
} // namespace spectrel
