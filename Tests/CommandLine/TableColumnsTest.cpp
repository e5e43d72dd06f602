#include "CommandLine/Output/TableColumns.h"

#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

std::string columns(std::string_view text)
{
    const auto parsed = parseTableColumns(text);
    if (!parsed)
        return "none";
    std::string shown;
    for (const TableColumn& column : *parsed)
        shown += "[" + column.path + "|" + column.name + "]";
    return shown;
}

TEST(ParseTableColumnsTest, ColumnHasANameOfItsOwnOrItsPath)
{
    EXPECT_EQ(columns("/A/B"), "[/A/B|/A/B]");
    EXPECT_EQ(columns("/A/B=x,/C,/D=y z"), "[/A/B|x][/C|/C][/D|y z]");
    EXPECT_EQ(columns("A/B=x=y"), "[/A/B|x=y]");
    EXPECT_EQ(columns("/A="), "[/A|]");
}

TEST(ParseTableColumnsTest, CellsAreTheColumnsOfTheServingCell)
{
    const auto parsed = parseTableColumns("cells,/A,cells=c,/cells");
    ASSERT_TRUE(parsed);
    ASSERT_EQ(parsed->size(), 4u);
    EXPECT_TRUE((*parsed)[0].isServingCell);
    EXPECT_FALSE((*parsed)[1].isServingCell);
    EXPECT_FALSE((*parsed)[2].isServingCell);
    EXPECT_FALSE((*parsed)[3].isServingCell);
}

TEST(ParseTableColumnsTest, BackslashMakesTextOfASign)
{
    EXPECT_EQ(columns(R"(/A\,B\=C=x\,y)"), "[/A,B=C|x,y]");
    EXPECT_EQ(columns(R"(/A\\,/B\x\)"), R"([/A\|/A\][/B\x\|/B\x\])");
}

TEST(ParseTableColumnsTest, MissingPathIsNoColumn)
{
    for (const char* text : {"", ",", "/A,", ",/A", "=x", "/A,=x"})
        EXPECT_EQ(columns(text), "none") << text;
}

std::string leaf(const Value& display, std::string_view path)
{
    return std::string(leafAtPath(display, path).value_or("(none)"));
}

TEST(LeafAtPathTest, LeafIsFoundInDictionariesAndLists)
{
    const Value display = Dictionary::make(
        {{"A", Dictionary::make({{"B", "1"}})}, {"L", List::make({"x", Dictionary::make({{"k", "v"}})})}});
    EXPECT_EQ(leaf(display, "/A/B"), "1");
    EXPECT_EQ(leaf(display, "/L/0"), "x");
    EXPECT_EQ(leaf(display, "/L/1/k"), "v");
    for (const char* path :
        {"/", "/A", "/A/", "/A/C", "/A/B/C", "/L", "/L/2", "/L/00", "/L/0/k", "/L/-1", "/L/1k", "/L/"})
        EXPECT_EQ(leaf(display, path), "(none)") << path;
}

TEST(LeafAtPathTest, NamesAreThoseOfTheTree)
{
    const Value display = Dictionary::make({{"_sorted", ""}, {"2;X", "later"}, {"1;X", "earlier"}, {"3;Y", "y"}});
    EXPECT_EQ(leaf(display, "/X"), "later"); // of several under one path the last
    EXPECT_EQ(leaf(display, "/Y"), "y");
    EXPECT_EQ(leaf(display, "/3;Y"), "(none)");
    EXPECT_EQ(leaf(display, "/_sorted"), "(none)");
}

TEST(LeafAtPathTest, NameMayHoldSlashes)
{
    const Value display = Dictionary::make(
        {{"F", Dictionary::make({{"Ec", "no"}, {"Ec/Io", "-3"}, {"", "e"}, {"a/", Dictionary::make({{"b", "c"}})}})}});
    EXPECT_EQ(leaf(display, "/F/Ec/Io"), "-3");
    EXPECT_EQ(leaf(display, "/F/Ec"), "no");
    EXPECT_EQ(leaf(display, "/F"), "e");
    EXPECT_EQ(leaf(display, "/F/a/b"), "c");
}

TEST(LeafAtPathTest, AnythingButTextIsUnknown)
{
    EXPECT_EQ(leaf(Dictionary::make({{"A", Value::integer(1)}}), "/A"), "(unknown)");
    EXPECT_EQ(leaf({}, "/A"), "(none)");
    EXPECT_EQ(leaf("text", "/A"), "(none)");
}

} // namespace
} // namespace spectrel
