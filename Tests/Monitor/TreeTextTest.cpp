#include "Monitor/TreeText.h"

#include "Values/Dictionary.h"
#include "Values/List.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

NodeRef tree(const Value& display)
{
    PathIndex index;
    return SpectrelModelNode::makeTreeFromObject(display, index);
}

std::string treeText(const Value& display)
{
    std::string text;
    appendTreeText(*tree(display), text);
    return text;
}

TEST(TreeTextTest, TheRootsTextHasItsChildrenNotIndented)
{
    EXPECT_EQ(treeText(Dictionary::make({{"Cell", Dictionary::make({{"ID", "7"}})}, {"List", List::make({"a", "b"})}})),
        "Cell\n  ID: 7\nList\n  0: a\n  1: b\n");
}

TEST(TreeTextTest, ALeafsTextIsItsValue)
{
    EXPECT_EQ(treeText("idle"), "idle\n");
    EXPECT_EQ(treeText({}), "(unknown)\n");
    EXPECT_EQ(treeText(Dictionary::make()), "");
}

TEST(TreeTextTest, ANodesTextBeginsWithItsOwnLine)
{
    std::string text;
    const NodeRef root = tree(Dictionary::make({{"Cell", Dictionary::make({{"ID", "7"}})}}));
    appendNodeText(*root->childNodes()->front(), text);
    EXPECT_EQ(text, "Cell\n  ID: 7\n");
}

TEST(TreeTextTest, ControlCharactersNeverBreakALine)
{
    EXPECT_EQ(treeText(Dictionary::make({{"a\tb", "c\n\x7F"}})), "a\\x09b: c\\x0a\\x7f\n");
}

} // namespace
} // namespace spectrel
