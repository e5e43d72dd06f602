#include "Analysis/Cells/Reading.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(ReadingTest, NumbersStandBeforeTheirUnits)
{
    EXPECT_EQ(readNumber(Reading::Number, "-91.75 dBm"), -91.75);
    EXPECT_EQ(readNumber(Reading::Number, "+7.48 dB"), 7.48);
    EXPECT_EQ(readNumber(Reading::Number, "136 × 64chips"), 136);
    EXPECT_EQ(readNumber(Reading::Number, "0"), 0);
}

TEST(ReadingTest, WhatIsNoNumberIsUnknown)
{
    for (const char* text : {"", " ", "-", "N/A", "nan dBm", "-inf dB", "Unknown", "12-3", "00F110 04B1", "1e5 dBm"})
        EXPECT_EQ(readNumber(Reading::Number, text), std::nullopt) << text;
}

TEST(ReadingTest, SixteenBitsShownWithoutSignAreSigned)
{
    EXPECT_EQ(readNumber(Reading::Signed16, "46"), 46);
    EXPECT_EQ(readNumber(Reading::Signed16, "65530"), -6);
    EXPECT_EQ(readNumber(Reading::Signed16, "65536"), std::nullopt);
}

TEST(ReadingTest, RXLEVIsInDBmFromItsTable) // 3GPP TS 45.008, 8.1.4
{
    EXPECT_EQ(readNumber(Reading::RXLEV, "0 dBm"), -110);
    EXPECT_EQ(readNumber(Reading::RXLEV, "63"), -47);
    EXPECT_EQ(readNumber(Reading::RXLEV, "64"), std::nullopt);
    EXPECT_EQ(readNumber(Reading::RXLEVWithoutUnit, "42"), -68);
    EXPECT_EQ(readNumber(Reading::RXLEVWithoutUnit, "-66 dBm"), -66);
}

TEST(ReadingTest, FilteredLevelsAre256thsOfReportedOnes) // 3GPP TS 25.123, 9.1.1.1.3
{
    EXPECT_EQ(readNumber(Reading::FilteredRSCP, "0.000000"), -116);
    EXPECT_EQ(readNumber(Reading::FilteredRSCP, "0.011719"), -113) << "3/256, rounded";
    EXPECT_EQ(readNumber(Reading::FilteredRSCP, "0.355469"), -25);
    EXPECT_EQ(readNumber(Reading::FilteredRSCP, "0.359375"), std::nullopt) << "there is no level 92";
    EXPECT_EQ(readNumber(Reading::FilteredRSCP, "0.002"), std::nullopt);
}

TEST(ReadingTest, ColourCodesAndBandClasses)
{
    EXPECT_EQ(readNumber(Reading::ColourCodes, "3-7"), 31);
    EXPECT_EQ(readNumber(Reading::ColourCodes, "3-8"), std::nullopt);
    EXPECT_EQ(readNumber(Reading::BracketedNumber, "900 MHzband [9]"), 9);
    EXPECT_EQ(readNumber(Reading::BracketedNumber, "[Bad Value 77]"), std::nullopt);
}

TEST(ReadingTest, PilotsMayBeTheReference)
{
    EXPECT_EQ(readNumber(Reading::Pilot, "(ref pilot) -7.49 dB"), -7.49);
    EXPECT_EQ(readNumber(Reading::Pilot, "-9.00 dB"), -9);
    EXPECT_EQ(readNumber(Reading::Pilot, "(ref pilot) -50.00 dB"), std::nullopt);
}

} // namespace
} // namespace spectrel
