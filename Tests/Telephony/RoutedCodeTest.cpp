#include "Telephony/RoutedCode.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(RoutedCodeTest, IsReadBehindAWrapperAndOnlyFromKnownTypes)
{
    std::uint32_t code = 0;
    Bytes record {0xFF, 12, 0, 2, 0, 0, 0, 0, 0, 0, 0, 0, 0};
    EXPECT_TRUE(routedCode(record, code));
    EXPECT_EQ(code, 0xFF0002u);
    record.insert(record.begin(), {0x81, 0});
    EXPECT_TRUE(routedCode(record, code));
    EXPECT_EQ(code, 0xFF0002u);
    record[2] = 0x10;
    EXPECT_FALSE(routedCode(record, code));
    EXPECT_FALSE(routedCode(Bytes(12, 1), code));
    EXPECT_FALSE(routedCode({}, code));
}

} // namespace
} // namespace spectrel
