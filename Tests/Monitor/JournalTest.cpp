#include "Monitor/Journal.h"

#include "LogGenerator/LogGenerator.h"

#include <gtest/gtest.h>
#include <initializer_list>
#include <string>

namespace spectrel {
namespace {

class JournalTest : public testing::Test {
protected:
    explicit JournalTest(std::initializer_list<Dictionary::Entry> leaves = {{"A", "1"}, {"B", "2"}})
        : display(Dictionary::make(leaves))
    {
        state->set(StateKey::Display, display);
        journal.forgetChanges();
    }
    /// What has been noted since this was asked last: "+" stored, "=" stored again, "-" removed.
    std::string noted()
    {
        journal.finishMessage();
        std::string text;
        for (const Journal::Change& change : journal.changes()) {
            const char* const marks = "+=-";
            text += marks[static_cast<int>(change.kind)] + journal.pathOf(change) + ":"
                + std::string(journal.valueOf(change)) + " ";
        }
        journal.forgetChanges();
        return text;
    }

    const DictionaryRef state = Dictionary::make();
    const DictionaryRef display;
    Journal journal {state};
};

TEST_F(JournalTest, EachKindIsNotedInOrder)
{
    display->setText("B", "9");
    display->set("A", "1");
    display->remove("B");
    display->setText("C", "3");
    display->setText("C", "3");
    EXPECT_EQ(noted(), "+/B:9 =/A:1 -/B:9 +/C:3 =/C:3 ");
    EXPECT_EQ(noted(), "");
}

TEST_F(JournalTest, RemovingWhatIsNotThereIsNoChange)
{
    display->remove("Z");
    state->setText("Other", "x");
    EXPECT_EQ(noted(), "");
}

TEST_F(JournalTest, WhatIsNoTextIsUnknown)
{
    display->set("A", Value::integer(1));
    display->set("A", Value::integer(1));
    display->set("A", Value::integer(2));
    EXPECT_EQ(noted(), "+/A:(unknown) =/A:(unknown) +/A:(unknown) ");
}

TEST_F(JournalTest, NestedContainersAreFollowedOnceStored)
{
    const auto inner = Dictionary::make({{"x", "1"}});
    display->set("Outer", Dictionary::make({{"Inner", inner}}));
    inner->setText("x", "2");
    inner->setText("/y", "3");
    EXPECT_EQ(noted(), "+/Outer/Inner/x:1 +/Outer/Inner/x:2 +/Outer/Inner/y:3 ");
}

TEST_F(JournalTest, RemovedSubtreeTakesItsLeavesAlongAndIsFollowedNoMore)
{
    const auto inner = Dictionary::make({{"x", "1"}});
    const auto list = List::make({"a", inner});
    display->set("Outer", list);
    noted();
    display->remove("Outer");
    inner->setText("x", "2");
    list->append("b");
    EXPECT_EQ(noted(), "-/Outer/0:a -/Outer/1/x:1 ");
    EXPECT_EQ(inner->observer(), nullptr);
    EXPECT_EQ(list->observer(), nullptr);
}

TEST_F(JournalTest, PathsAreThoseOfTheTimeOfTheChange)
{
    const auto inner = Dictionary::make({{"x", "1"}});
    display->set("Outer", inner);
    noted();
    inner->setText("x", "2");
    display->remove("Outer");
    display->set("Elsewhere", inner);
    EXPECT_EQ(noted(), "+/Outer/x:2 -/Outer/x:2 +/Elsewhere/x:2 ");
}

TEST_F(JournalTest, ContainerStoredOverAnotherIsComparedWithIt)
{
    display->set("C", Dictionary::make({{"x", "1"}, {"y", "2"}, {"z", "3"}}));
    noted();
    display->set("C", Dictionary::make({{"z", "3"}, {"x", "9"}, {"w", "0"}}));
    EXPECT_EQ(noted(), "=/C/z:3 +/C/x:9 +/C/w:0 -/C/y:2 ");
    display->set("C", "text");
    display->set("C", List::make({"a"}));
    EXPECT_EQ(noted(), "-/C/z:3 -/C/x:9 -/C/w:0 +/C:text -/C:text +/C/0:a ");
}

TEST_F(JournalTest, TextStoredOverAContainerTakesItsPlace)
{
    const auto inner = Dictionary::make({{"x", "1"}});
    display->set("A", inner);
    noted();
    display->setText("A", "2");
    inner->setText("x", "3");
    EXPECT_EQ(noted(), "-/A/x:1 +/A:2 ");
}

TEST_F(JournalTest, RefilledListIsComparedWithWhatItHeld)
{
    const auto list = List::make({"a", "b", Dictionary::make({{"x", "1"}}), "d"});
    display->set("L", list);
    noted();
    list->removeAll();
    list->append("a");
    list->append("B");
    list->append(Dictionary::make({{"x", "1"}, {"y", "2"}}));
    EXPECT_EQ(noted(), "=/L/0:a +/L/1:B =/L/2/x:1 +/L/2/y:2 -/L/3:d ");
}

TEST_F(JournalTest, ListThatStaysEmptyLosesItsElementsAtTheEndOfTheMessage)
{
    const auto list = List::make({"a", Dictionary::make({{"x", "1"}})});
    display->set("L", list);
    noted();
    list->removeAll();
    list->removeAll();
    EXPECT_EQ(noted(), "-/L/0:a -/L/1/x:1 ");
    list->append("b");
    EXPECT_EQ(noted(), "+/L/0:b ");
}

TEST_F(JournalTest, ListThatGoesAwayWhileEmptyHasLostItsElements)
{
    const auto list = List::make({"a", Dictionary::make({{"x", "1"}})});
    display->set("L", list);
    noted();
    list->removeAll();
    display->remove("L");
    EXPECT_EQ(noted(), "-/L/0:a -/L/1/x:1 ");
}

TEST_F(JournalTest, ElementsBehindRemovedOnesMoveUp)
{
    const auto kept = Dictionary::make({{"x", "1"}});
    const auto list = List::make({"a", kept});
    display->set("L", list);
    noted();
    list->removeFirst(1);
    EXPECT_EQ(noted(), "-/L/0:a +/L/0/x:1 -/L/1/x:1 ");
    kept->setText("x", "2");
    EXPECT_EQ(noted(), "+/L/0/x:2 ");
}

TEST_F(JournalTest, SortedDictionaryShortensTheNamesOfItsKeys)
{
    display->set("Pilots", Dictionary::make({{"_sorted", "_sorted"}, {"0;12", "a"}}));
    EXPECT_EQ(noted(), "+/Pilots/12:a ");
    display->set("Pilots", Dictionary::make({{"_sorted", "_sorted"}, {"0;12", "a"}, {"1;7", "b"}}));
    EXPECT_EQ(noted(), "=/Pilots/12:a +/Pilots/7:b ");
}

TEST_F(JournalTest, ContainerAtTwoPlacesIsNotedAtBoth)
{
    const auto shared = Dictionary::make({{"x", "1"}});
    display->set("C", shared);
    display->set("D", List::make({shared}));
    noted();
    shared->setText("x", "2");
    display->remove("C");
    shared->setText("x", "2");
    EXPECT_EQ(noted(), "+/C/x:2 +/D/0/x:2 -/C/x:2 =/D/0/x:2 ");
}

TEST_F(JournalTest, ReplacedDisplayIsComparedWithTheOldOne)
{
    state->set(StateKey::Display, Dictionary::make({{"B", "2"}, {"A", "9"}}));
    display->setText("A", "unheard");
    EXPECT_EQ(noted(), "=/B:2 +/A:9 ");
    state->set(StateKey::Display, "text");
    state->set(StateKey::Display, "text");
    state->remove(StateKey::Display);
    EXPECT_EQ(noted(), "-/B:2 -/A:9 +/:text =/:text -/:text ");
}

TEST_F(JournalTest, DisplayThatIsThereAlreadyCountsAsStored)
{
    const auto other = Dictionary::make({{std::string(StateKey::Display), Dictionary::make({{"A", "1"}})}});
    const Journal late(other);
    ASSERT_EQ(late.changes().size(), 1u);
    EXPECT_EQ(late.pathOf(late.changes().front()), "/A");
}

TEST_F(JournalTest, NobodyIsFollowedOnceTheJournalIsGone)
{
    const auto inner = Dictionary::make({{"x", "1"}});
    const auto list = List::make({inner});
    const auto other = Dictionary::make({{std::string(StateKey::Display), list}});
    {
        const Journal brief(other);
        EXPECT_NE(inner->observer(), nullptr);
        list->removeAll();
    }
    EXPECT_EQ(other->observer(), nullptr);
    EXPECT_EQ(list->observer(), nullptr);
    EXPECT_EQ(inner->observer(), nullptr);
}

TEST_F(JournalTest, PlaceStaysTheSameWhileItsContainerStandsThere)
{
    display->setText("A", "2");
    const Journal::PlaceRef place = journal.changes().back().place;
    noted();
    display->setText("B", "3");
    EXPECT_EQ(journal.changes().back().place, place);
    state->set(StateKey::Display, Dictionary::make({{"A", "2"}}));
    EXPECT_NE(journal.changes()[1].place, place);
}

TEST_F(JournalTest, OnlyChangesStampAContainerAndThoseAbove)
{
    const auto inner = Dictionary::make({{"x", "1"}});
    display->set("C", inner);
    const std::uint64_t period = journal.beginPeriod();
    inner->setText("x", "1");
    EXPECT_LT(Journal::stampOf(display).changedWithin, period);
    inner->setText("x", "2");
    EXPECT_EQ(Journal::stampOf(inner).changed, period);
    EXPECT_EQ(Journal::stampOf(display).changedWithin, period);
    EXPECT_LT(Journal::stampOf(display).changed, period);
}

} // namespace
} // namespace spectrel
