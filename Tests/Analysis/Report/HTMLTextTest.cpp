#include "Analysis/Report/HTMLText.h"
#include "Analysis/Report/Axis.h"
#include "Analysis/Report/CellNames.h"

#include "Tests/Analysis/Report/ReportSamples.h"

#include <gmock/gmock.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;

TEST(HTMLTextTest, Numbers)
{
    EXPECT_EQ(decimalText(-104.46, 1), "-104.5");
    EXPECT_EQ(decimalText(-0.04, 1), "0.0");
    EXPECT_EQ(decimalText(0.05, 2), "0.05");
    EXPECT_EQ(decimalText(1815, 0), "1815");
    EXPECT_EQ(levelText(std::nullopt), "–");
}

TEST(HTMLTextTest, Times)
{
    EXPECT_EQ(clockText(ReportStart + 999ms), "14:07:31");
    EXPECT_EQ(dateText(ReportStart), "2024-03-05 14:07:31");
    EXPECT_EQ(machineTimeText(ReportStart), "2024-03-05T14:07:31Z");
    EXPECT_EQ(durationText(3723), "1:02:03");
    EXPECT_EQ(durationText(59.6), "1:00");
}

TEST(CellNamesTest, LettersGoOnAfterZ)
{
    EXPECT_EQ(cellLetters(0), "A");
    EXPECT_EQ(cellLetters(25), "Z");
    EXPECT_EQ(cellLetters(26), "AA");
    EXPECT_EQ(cellLetters(27), "AB");
    EXPECT_EQ(cellLetters(701), "ZZ");
    EXPECT_EQ(cellLetters(702), "AAA");
}

TEST(AxisTest, LevelsEndOnRoundNumbers)
{
    const LevelAxis axis = LevelAxis::around(-107.3, -83.1);
    EXPECT_THAT(axis.lines, ElementsAre(-110, -105, -100, -95, -90, -85, -80));
    const LevelAxis flat = LevelAxis::around(-90, -90);
    EXPECT_LT(flat.low, flat.high);
}

TEST(AxisTest, TimesFallOnRoundMinutes)
{
    const auto lines = timeLines(ReportStart, 30min);
    EXPECT_EQ(clockText(lines.front()), "14:10:00");
    EXPECT_EQ(lines[1] - lines[0], 5min);
    EXPECT_LE(lines.size(), 8u);
    EXPECT_LE(timeLines(ReportStart, 24h * 10000).size(), 9u);
}

} // namespace
} // namespace spectrel
