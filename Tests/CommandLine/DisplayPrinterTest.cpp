#include "CommandLine/Output/DisplayPrinter.h"

#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

std::string tree(const Value& display)
{
    std::string text;
    appendTree(display, text);
    return text;
}

std::string json(const Value& display)
{
    std::string text;
    appendJson(display, text);
    return text;
}

const Value Sorted = Dictionary::make({{"2;Down", "a"}, {"_sorted", ""}, {"1;Up", List::make({"b", "c"})}});

TEST(DisplayPrinterTest, TreeIsIndentedInDisplayOrder)
{
    EXPECT_EQ(tree(Sorted), "Up\n  0: b\n  1: c\nDown: a\n");
}

TEST(DisplayPrinterTest, JsonHasTheNamesAndTheOrderOfTheTree)
{
    EXPECT_EQ(json(Sorted), "{\"Up\":[\"b\",\"c\"],\"Down\":\"a\"}");
}

TEST(DisplayPrinterTest, AbsentDisplayIsUnknown)
{
    EXPECT_EQ(tree({}), "(unknown)\n");
    EXPECT_EQ(json({}), "\"(unknown)\"");
}

TEST(DisplayPrinterTest, AnythingElseIsUnknown)
{
    const Value display = List::make({Value::integer(1), Value::boolean(true), Date {0}});
    EXPECT_EQ(json(display), "[\"(unknown)\",\"(unknown)\",\"(unknown)\"]");
}

TEST(DisplayPrinterTest, ControlCharactersNeverReachTheTerminal)
{
    EXPECT_EQ(tree(Dictionary::make({{"a\tb", "line\nbreak\x1b[31m"}})), "a\\x09b: line\\x0abreak\\x1b[31m\n");
}

TEST(DisplayPrinterTest, JsonEscapesWhatItMust)
{
    EXPECT_EQ(json("a\"b\\c\n\x01\xC3\xA9"), "\"a\\\"b\\\\c\\n\\u0001\xC3\xA9\"");
}

class ChosenLeavesTest : public testing::Test {
protected:
    const Value display = Dictionary::make({{"A", Dictionary::make({{"x", "1"}, {"y", "2"}})},
        {"L", List::make({Dictionary::make({{"x", "3"}}), "plain", Dictionary::make({{"y", "4"}})})},
        {"E", Dictionary::make({})}, {"x", "5"}});

    std::string tree(const std::string& glob) const
    {
        std::string text;
        appendTree(display, text, PathChoice({glob}));
        return text;
    }
    std::string json(const std::string& glob) const
    {
        std::string text;
        appendJson(display, text, PathChoice({glob}));
        return text;
    }
};

TEST_F(ChosenLeavesTest, TreeHasThemAndTheNodesAboveThem)
{
    EXPECT_EQ(tree("**/y"), "A\n  y: 2\nL\n  2\n    y: 4\n");
    EXPECT_EQ(tree("/*"), "x: 5\n");
    EXPECT_EQ(tree("/nothing"), "");
}

TEST_F(ChosenLeavesTest, JsonHasThemAndTheNodesAboveThem)
{
    EXPECT_EQ(json("**/y"), R"({"A":{"y":"2"},"L":[{"y":"4"}]})");
    EXPECT_EQ(json("/*"), R"({"x":"5"})");
    EXPECT_EQ(json("/L/1"), R"({"L":["plain"]})");
    EXPECT_EQ(json("/nothing"), "{}");
}

TEST_F(ChosenLeavesTest, NodesWithoutLeavesStayWhereAllIsChosen)
{
    EXPECT_EQ(json("**"), R"({"A":{"x":"1","y":"2"},"L":[{"x":"3"},"plain",{"y":"4"}],"x":"5"})");
    std::string text;
    appendJson(display, text);
    EXPECT_NE(text.find(R"("E":{})"), std::string::npos);
}

TEST_F(ChosenLeavesTest, DisplayThatIsNoneIsUnknownAllTheSame)
{
    std::string text;
    appendJson({}, text, PathChoice({"/A"}));
    appendTree({}, text, PathChoice({"/A"}));
    EXPECT_EQ(text, "\"(unknown)\"(unknown)\n");
}

} // namespace
} // namespace spectrel
