#include "Values/Table.h"

#include <array>
#include <gtest/gtest.h>
#include <string_view>

namespace spectrel {
namespace {

struct Row {
    int code;
    std::string_view name;
};
constexpr std::array<Row, 3> Rows {{{7, "seven"}, {2, "two"}, {7, "seven again"}}};

static_assert(findRow(Rows, 2, &Row::code) == &Rows[1]);

TEST(TableTest, FindsTheFirstRowByEitherMember)
{
    EXPECT_EQ(findRow(Rows, 7, &Row::code), &Rows[0]);
    EXPECT_EQ(findRow(Rows, "seven again", &Row::name), &Rows[2]);
}

TEST(TableTest, NoRowIsNull)
{
    EXPECT_EQ(findRow(Rows, 3, &Row::code), nullptr);
    EXPECT_EQ(findRow(Rows, "", &Row::name), nullptr);
}

} // namespace
} // namespace spectrel
