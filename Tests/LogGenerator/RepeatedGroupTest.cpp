#include "LogGenerator/Template/RepeatedGroup.h"

#include "Tests/Fakes/DisplayText.h"

#include <array>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

constexpr std::array<std::uint8_t, 8> Raw {9, 9, 1, 2, 3, 4, 5, 6};
constexpr std::array<Field, 2> Entry {{{1, Width::U8, "B", decimal}, {0, Width::U8, "A", decimal}}};

TEST(RepeatedGroupTest, EntriesFollowEachOther)
{
    constexpr RepeatedGroup Group {2, 3, 2};
    EXPECT_EQ(Group.entry(0), 2u);
    EXPECT_EQ(Group.entry(1), 5u);
}

TEST(RepeatedGroupTest, IndexAtItsCountAndPastItRaises)
{
    constexpr RepeatedGroup Group {2, 3, 2};
    EXPECT_THROW(Group.entry(2), ArrayOutOfBoundsException);
    EXPECT_THROW(Group.entry(255), ArrayOutOfBoundsException);
    EXPECT_THROW((RepeatedGroup {2, 3, 0}.entry(0)), ArrayOutOfBoundsException);
}

TEST(RepeatedGroupTest, EachEntryIsADictionary)
{
    EXPECT_EQ(displayText(Value(entriesWithFields(ByteView(Raw), {2, 3, 2}, Entry))),
        "[{\"B\": \"2\", \"A\": \"1\"}, {\"B\": \"5\", \"A\": \"4\"}]");
}

TEST(RepeatedGroupTest, EntriesPastTheRecordsEndReadAsZeros)
{
    EXPECT_EQ(displayText(Value(entriesWithFields(ByteView(Raw), {7, 1, 2}, Entry))),
        "[{\"B\": \"0\", \"A\": \"6\"}, {\"B\": \"0\", \"A\": \"0\"}]");
}

} // namespace
} // namespace spectrel
