#include "Analysis/NetworkCode.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(NetworkCodeTest, DigitsKeepTheirZerosAndTheirNumber)
{
    NetworkCode code;
    EXPECT_EQ(code.read("001", "01 "), "001-01");
    EXPECT_EQ(code.read("310", "026"), "310-026");
    EXPECT_EQ(code.read("262", "001"), "262-001");
}

TEST(NetworkCodeTest, EqualPlainNumbersAreTheDigitsReadBefore)
{
    NetworkCode code;
    code.read("262", "001");
    EXPECT_EQ(code.read("262", "1"), "262-001");
    EXPECT_EQ(code.read("262", "2"), "262-02");
    EXPECT_EQ(code.read("1", "1"), "001-01");
}

TEST(NetworkCodeTest, PlainNumbersHaveThreeDigitsWhereTheCountryGivesOutSuch)
{
    NetworkCode code;
    EXPECT_EQ(code.read("310", "26"), "310-026");
    EXPECT_EQ(code.read("262", "7"), "262-07");
}

TEST(NetworkCodeTest, WhatIsNoNetworkIsEmpty)
{
    NetworkCode code;
    for (const auto& [country, network] : {std::pair("", ""), {"   ", "   "}, {"0", "1"}, {"1", ""}, {"-", "-"},
             {"0 1", "01 "}, {"1234", "1"}, {"262", "1 "}, {"262", "-1"}})
        EXPECT_EQ(code.read(country, network), "") << country << "/" << network;
}

TEST(NetworkCodeTest, FormIsChecked)
{
    EXPECT_TRUE(isNetworkCode("001-01"));
    EXPECT_TRUE(isNetworkCode("310-260"));
    for (const char* text : {"", "00101", "001-1", "001-0123", "abc-01", "001-0x"})
        EXPECT_FALSE(isNetworkCode(text)) << text;
}

} // namespace
} // namespace spectrel
