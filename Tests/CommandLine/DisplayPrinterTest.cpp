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

} // namespace
} // namespace spectrel
