#include "Values/TextBuffer.h"

#include <cmath>
#include <cstdio>
#include <cstring>
#include <gtest/gtest.h>
#include <limits>
#include <random>
#include <string>

namespace spectrel {

namespace {

std::string fixed2(double number)
{
    TextBuffer buffer;
    return std::string(buffer.fixed2(number).view());
}

std::string printed(double number)
{
    char text[400];
    std::snprintf(text, sizeof text, "%4.2f", number);
    return text;
}

} // namespace

TEST(TextBufferTest, DecimalsAreAsPrintfMakesThem)
{
    for (const std::int64_t number : {std::int64_t(0), std::int64_t(-1), std::int64_t(4294967295),
             std::numeric_limits<std::int64_t>::min(), std::numeric_limits<std::int64_t>::max()}) {
        TextBuffer buffer;
        EXPECT_EQ(buffer.decimal(number).view(), std::to_string(number));
    }
}

TEST(TextBufferTest, TwoDecimalsAreAsPrintfMakesThemTiesIncluded)
{
    for (int eighths = -80000; eighths <= 80000; ++eighths)
        ASSERT_EQ(fixed2(eighths / 8.0), printed(eighths / 8.0)); // every .125 and .375 is a tie
    for (int thousandths = -20000; thousandths <= 20000; ++thousandths)
        ASSERT_EQ(fixed2(thousandths / 1000.0), printed(thousandths / 1000.0));
}

TEST(TextBufferTest, TwoDecimalsAreAsPrintfMakesThemForAnyDouble)
{
    std::mt19937_64 random(7);
    for (int i = 0; i < 20000; ++i) {
        const std::uint64_t bits = random();
        double number = 0;
        static_assert(sizeof number == sizeof bits);
        std::memcpy(&number, &bits, sizeof number);
        if (!std::isnan(number)) {
            ASSERT_EQ(fixed2(number), printed(number));
        }
    }
}

TEST(TextBufferTest, ExtremesAreAsPrintfMakesThem)
{
    using Limits = std::numeric_limits<double>;
    for (const double number : {0.0, -0.0, Limits::max(), Limits::lowest(), Limits::min(), Limits::denorm_min(),
             Limits::infinity(), -Limits::infinity(), 0.004999, 0.005, -0.001})
        EXPECT_EQ(fixed2(number), printed(number));
}

TEST(TextBufferTest, NotANumberNeverHasASign)
{
    EXPECT_EQ(fixed2(std::numeric_limits<double>::quiet_NaN()), " nan");
    EXPECT_EQ(fixed2(-std::numeric_limits<double>::quiet_NaN()), " nan");
}

TEST(TextBufferTest, SixDecimalsAreAsPrintfMakesThem)
{
    using Limits = std::numeric_limits<double>;
    for (const double number : {0.0, -0.0, -7.5, 63.5, 1.0 / 256, 2.0 / 3, Limits::max(), Limits::lowest(),
             Limits::denorm_min(), Limits::infinity(), -Limits::infinity()}) {
        char text[400];
        std::snprintf(text, sizeof text, "%f", number);
        EXPECT_EQ(TextBuffer().fixed6(number).view(), text);
    }
    EXPECT_EQ(TextBuffer().fixed6(-Limits::quiet_NaN()).view(), "nan");
}

TEST(TextBufferTest, PiecesFollowEachOtherUntilCleared)
{
    TextBuffer buffer;
    buffer.decimal(-71).text(" dBm, ").fixed2(0.5).text(" dB");
    EXPECT_EQ(buffer.view(), "-71 dBm, 0.50 dB");
    buffer.clear();
    EXPECT_EQ(buffer.text("x").view(), "x");
}

TEST(TextBufferTest, WhatDoesNotFitIsCut)
{
    TextBuffer buffer;
    buffer.text(std::string(399, 'a'));
    buffer.decimal(12345); // a number is not cut in the middle
    EXPECT_EQ(buffer.view(), std::string(399, 'a'));
    buffer.text("bc").text("d");
    EXPECT_EQ(buffer.view(), std::string(399, 'a') + "b");
}

} // namespace spectrel
