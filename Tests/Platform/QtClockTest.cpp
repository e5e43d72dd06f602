#include "Platform/Qt/QtClock.h"

#include <cstdlib>
#include <gtest/gtest.h>

namespace spectrel {
namespace {

constexpr std::string_view StatusPattern = "'Updated' yyyy-MM-dd 'at' HH:mm:ss";
constexpr Moment Winter {std::chrono::microseconds(1'709'647'651'999'999)}; // 2024-03-05 14:07:31.999999 UTC
constexpr Moment Summer {std::chrono::microseconds(1'719'878'400'000'000)}; // 2024-07-02 00:00:00 UTC

TEST(QtClockTest, FormatsByPatternInItsZone)
{
    EXPECT_EQ(QtClock("UTC").formatted(Winter, StatusPattern), "Updated 2024-03-05 at 14:07:31");
    EXPECT_EQ(QtClock("Europe/Berlin").formatted(Winter, StatusPattern), "Updated 2024-03-05 at 15:07:31");
    EXPECT_EQ(QtClock("Europe/Berlin").formatted(Summer, StatusPattern), "Updated 2024-07-02 at 02:00:00");
    EXPECT_EQ(QtClock("America/St_Johns").formatted(Summer, StatusPattern), "Updated 2024-07-01 at 21:30:00");
}

TEST(QtClockTest, ZoneStateKnowsDaylightSaving)
{
    const QtClock berlin("Europe/Berlin");
    EXPECT_EQ(berlin.zoneAt(Winter).secondsEastOfUTC, 3600);
    EXPECT_FALSE(berlin.zoneAt(Winter).isDaylightSaving);
    EXPECT_EQ(berlin.zoneAt(Summer).secondsEastOfUTC, 7200);
    EXPECT_TRUE(berlin.zoneAt(Summer).isDaylightSaving);
}

TEST(QtClockTest, MomentsBefore1970AreRoundedDown)
{
    EXPECT_EQ(QtClock("UTC").formatted(Moment(std::chrono::microseconds(-1)), StatusPattern),
        "Updated 1969-12-31 at 23:59:59");
}

TEST(QtClockTest, UnknownZoneMeansUTC)
{
    EXPECT_EQ(QtClock("Nowhere/At_All").formatted(Winter, StatusPattern), "Updated 2024-03-05 at 14:07:31");
}

TEST(QtClockTest, FollowsTheDevicesZone)
{
    const char* const former = std::getenv("TZ");
    const std::string kept = former ? former : "";
    ::setenv("TZ", "Asia/Kolkata", 1);
    EXPECT_EQ(QtClock().zoneAt(Winter).secondsEastOfUTC, 19'800);
    ::setenv("TZ", "Asia/Tokyo", 1);
    EXPECT_EQ(QtClock().zoneAt(Winter).secondsEastOfUTC, 32'400);
    former ? ::setenv("TZ", kept.c_str(), 1) : ::unsetenv("TZ");
}

TEST(QtClockTest, NowIsTheSystemsTime)
{
    const auto before = std::chrono::system_clock::now();
    const auto now = QtClock().now();
    EXPECT_GE(now, std::chrono::floor<std::chrono::microseconds>(before));
    EXPECT_LE(now, std::chrono::system_clock::now());
}

} // namespace
} // namespace spectrel
