#include "Analysis/Series/DisplayNumbers.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(DisplayNumberTest, NumbersAreReadWithOrWithoutAUnit)
{
    EXPECT_EQ(displayNumber("12"), 12.0);
    EXPECT_EQ(displayNumber("-104.5 dBm"), -104.5);
    EXPECT_EQ(displayNumber("+3 dB"), 3.0);
    EXPECT_EQ(displayNumber("20 MHz"), 20.0);
    EXPECT_EQ(displayNumber("0"), 0.0);
    EXPECT_EQ(displayNumber("0.25"), 0.25);
    EXPECT_EQ(displayNumber("7%"), 7.0);
    EXPECT_EQ(displayNumber("123456789012345"), 123456789012345.0);
}

TEST(DisplayNumberTest, AnythingElseIsNone)
{
    for (const char* text : {"", "-", "N/A", "nan", "inf", "001", "001-01", "3-7", "1 of 2", "192.0.2.17",
             "2001:db8::", "12x", "0x1F", "1234567890123456", ".", ".5", "5.", "--5", "1e5", " 5", "4th"})
        EXPECT_EQ(displayNumber(text), std::nullopt) << text;
}

} // namespace
} // namespace spectrel
