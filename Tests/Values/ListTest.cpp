#include "Values/List.h"

#include "Values/Dictionary.h"

#include <gtest/gtest.h>

namespace spectrel {

TEST(ListTest, AppendsInOrderAndSkipsAbsentValues)
{
    const ListRef list = List::make({"a", Value()});
    list->append("b");
    list->append(Value());
    ASSERT_EQ(list->count(), 2u);
    EXPECT_EQ(*(*list)[0].string(), "a");
    EXPECT_EQ(*(*list)[1].string(), "b");
}

TEST(ListTest, RemovesFromTheFrontAtMostAll)
{
    const ListRef list = List::make({"a", "b", "c"});
    list->removeFirst(0);
    EXPECT_EQ(list->count(), 3u);
    list->removeFirst(2);
    EXPECT_EQ(*(*list)[0].string(), "c");
    list->removeFirst(5);
    EXPECT_EQ(list->count(), 0u);
}

TEST(ListTest, CopySharesTheContainersInside)
{
    const ListRef list = List::make({Dictionary::make()});
    const ListRef copied = list->copy();
    copied->append("more");
    (*copied)[0].dictionary()->setText("k", "v");
    EXPECT_EQ(list->count(), 1u);
    EXPECT_TRUE((*list)[0].dictionary()->contains("k"));
}

TEST(ListTest, RemoveAllEmpties)
{
    const ListRef list = List::make({"a"});
    list->removeAll();
    EXPECT_EQ(list->count(), 0u);
}

} // namespace spectrel
