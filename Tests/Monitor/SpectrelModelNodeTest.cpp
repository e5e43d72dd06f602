#include "Monitor/SpectrelModelNode.h"

#include "LogGenerator/Template/ArrayLock.h"
#include "Values/Dictionary.h"
#include "Values/List.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

class DisplayTreeTest : public testing::Test {
protected:
    NodeRef build(const Value& display)
    {
        index.clear();
        return SpectrelModelNode::makeTreeFromObject(display, index);
    }
    std::string children(const NodeRef& node)
    {
        std::string names;
        for (const NodeRef& child : *node->childNodes())
            names += child->displayName() + (child->childNodes() ? "/ " : "=" + *child->value() + " ");
        return names;
    }
    std::string paths()
    {
        std::vector<std::string> sorted;
        for (const auto& [path, node] : index)
            sorted.push_back(path);
        std::ranges::sort(sorted);
        std::string text;
        for (const std::string& path : sorted)
            text += path + " ";
        return text;
    }
    PathIndex index;
};

TEST_F(DisplayTreeTest, TextIsARootLeaf)
{
    const NodeRef root = build("hello");
    EXPECT_EQ(root->displayName(), "Spectrel");
    EXPECT_EQ(*root->value(), "hello");
    EXPECT_EQ(root->childNodes(), nullptr);
}

TEST_F(DisplayTreeTest, AbsentDisplayIsARootLeafOfUnknownValue)
{
    const NodeRef root = build({});
    EXPECT_EQ(root->displayName(), "Spectrel");
    EXPECT_EQ(*root->value(), "(unknown)");
    EXPECT_EQ(paths(), "/ ");
}

TEST_F(DisplayTreeTest, EmptyDictionaryIsARootWithoutChildren)
{
    const NodeRef root = build(Dictionary::make());
    EXPECT_TRUE(root->childNodes()->empty());
    EXPECT_EQ(root->value(), nullptr);
    EXPECT_EQ(paths(), "/ ");
}

TEST_F(DisplayTreeTest, MarkerSortsByTheWholeKeyAndShowsTheSecondPart)
{
    const NodeRef root = build(Dictionary::make({{"2;B", "b"}, {"_sorted", Value::integer(1)}, {"1;A", "a"}}));
    EXPECT_EQ(children(root), "A=a B=b ");
    EXPECT_EQ(paths(), "/ /A /B ");
}

TEST_F(DisplayTreeTest, KeysOfThreePartsAreShownWhole)
{
    EXPECT_EQ(children(build(Dictionary::make({{"_sorted", ""}, {"1;2;C", "c"}, {"plain", "d"}, {"3;", "e"}}))),
        "1;2;C=c =e plain=d ");
}

TEST_F(DisplayTreeTest, WithoutTheMarkerKeysAreShownWholeInTheirOwnOrder)
{
    EXPECT_EQ(children(build(Dictionary::make({{"2;B", "b"}, {"1;A", "a"}}))), "2;B=b 1;A=a ");
}

TEST_F(DisplayTreeTest, AnythingElseIsALeafOfUnknownValue)
{
    EXPECT_EQ(children(build(Dictionary::make({{"n", Value::integer(5)}, {"r", Value::real(1)},
                  {"b", Value::boolean(true)}, {"d", Date {1}}, {"x", DataRef(std::make_shared<Bytes>())}}))),
        "n=(unknown) r=(unknown) b=(unknown) d=(unknown) x=(unknown) ");
}

TEST_F(DisplayTreeTest, ListElementsAreNamedByPosition)
{
    const NodeRef root = build(List::make({"text", Dictionary::make({{"k", "v"}})}));
    EXPECT_EQ(children(root), "0=text 1/ ");
    EXPECT_EQ(paths(), "/ /0 /1 /1/k ");
    EXPECT_EQ(*index["/1/k"]->value(), "v");
}

TEST_F(DisplayTreeTest, OfTwoSiblingsWithOnePathTheLaterIsFound)
{
    build(Dictionary::make({{"_sorted", ""}, {"1;A", "first"}, {"2;A", "second"}}));
    EXPECT_EQ(*index["/A"]->value(), "second");
}

TEST_F(DisplayTreeTest, ParentIsFoundBeforeADescendantOfTheSamePath)
{
    build(Dictionary::make({{"A", Dictionary::make({{"", "nameless"}})}}));
    EXPECT_NE(index["/A"]->childNodes(), nullptr);
}

TEST_F(DisplayTreeTest, SlashesInNamesStay)
{
    build(Dictionary::make({{"SIM Info", Dictionary::make({{"EF-GPRS/PS-LOCI", "x"}})}}));
    EXPECT_EQ(*index["/SIM Info/EF-GPRS/PS-LOCI"]->value(), "x");
}

TEST_F(DisplayTreeTest, NestedListsLeaveTheArrayLockToTheirThread)
{
    const NodeRef root = build(List::make({List::make({"a"}), "b"}));
    EXPECT_EQ(children(root), "0/ 1=b ");
    EXPECT_EQ(paths(), "/ /0 /0/0 /1 ");
    ArrayLock::mutex().unlock();
}

TEST(PathByAppendingTest, JoinsWithExactlyOneSlash)
{
    EXPECT_EQ(pathByAppending("/", "Serving Cell"), "/Serving Cell");
    EXPECT_EQ(pathByAppending("/Serving Cell", "0"), "/Serving Cell/0");
    EXPECT_EQ(pathByAppending("/A", "/B"), "/A/B");
    EXPECT_EQ(pathByAppending("/A", ""), "/A");
}

} // namespace
} // namespace spectrel
