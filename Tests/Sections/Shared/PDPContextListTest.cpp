#include "Sections/Shared/PDPContextList.h"

#include "Tests/Sections/SectionFixture.h"

namespace spectrel {
namespace {

class PDPContextListTest : public SectionFixture<PDPContextList> {
protected:
    PDPContextListTest()
        : SectionFixture(List::make({"old"}))
    {
    }
};

TEST_F(PDPContextListTest, ListReplacesTheContextsAsTheyCame)
{
    deliverPropertyList(
        0xFF0002, List::make({Dictionary::make({{"APN", "internet"}, {"CID", Value::integer(1)}}), "odd"}));
    EXPECT_EQ(display(), "[{\"APN\": \"internet\", \"CID\": int 1}, \"odd\"]");
    EXPECT_EQ(log(), "<4>PDPContextList\n");
}

TEST_F(PDPContextListTest, DictionaryLeavesTheContextsUnchanged)
{
    deliverPropertyList(0xFF0002, Dictionary::make({{"APN", "internet"}}));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), "<4>PDPContextList\n");
}

TEST_F(PDPContextListTest, EmptyListEmptiesTheContexts)
{
    deliverPropertyList(0xFF0002, List::make());
    EXPECT_EQ(display(), "[]");
}

TEST_F(PDPContextListTest, GarbageLeavesTheContextsUnchangedWithoutAMessage)
{
    const Bytes garbage {1, 2, 3};
    deliver(0xFF0002, RecordBuilder::withPayload(0xFF0002, garbage));
    EXPECT_EQ(display(), "[\"old\"]");
    EXPECT_EQ(log(), "<4>PDPContextList\n");
}

TEST_F(PDPContextListTest, NodeThatIsNoListTakesNothing)
{
    section.updateSectionRef(Dictionary::make());
    deliverPropertyList(0xFF0002, List::make({"new"}));
    section.updateSectionRef({});
    deliverPropertyList(0xFF0002, List::make({"new"}));
    EXPECT_EQ(display(), "[\"old\"]");
}

} // namespace
} // namespace spectrel
