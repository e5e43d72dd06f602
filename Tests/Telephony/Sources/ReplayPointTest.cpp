#include "Telephony/Sources/ReplayPoint.h"

#include "Tests/Fakes/FakeRunLoop.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

class ReplayPointTest : public testing::Test {
protected:
    /// The point in a recording that starts at 2024-03-05 14:07:31 UTC.
    std::string place(std::string_view text)
    {
        const auto point = ReplayPoint::wallClock(text);
        return point ? defaultDateForm(point->in(FakeRunLoop::Start, clock)) : "none";
    }
    FakeRunLoop clock;
};

TEST_F(ReplayPointTest, OffsetCountsFromTheFirstMessage)
{
    const auto point = ReplayPoint::after(std::chrono::seconds(90));
    EXPECT_EQ(defaultDateForm(point.in(FakeRunLoop::Start, clock)), "2024-03-05 14:09:01 +0000");
}

TEST_F(ReplayPointTest, DateAndTimeAreLocalUnlessAZoneIsGiven)
{
    clock.setZone({7200, false});
    EXPECT_EQ(place("2024-03-06 01:30:05"), "2024-03-05 23:30:05 +0000");
    EXPECT_EQ(place("2024-03-06T01:30"), "2024-03-05 23:30:00 +0000");
    EXPECT_EQ(place("2024-03-06 01:30:05Z"), "2024-03-06 01:30:05 +0000");
    EXPECT_EQ(place("2024-03-06 01:30:05 +0530"), "2024-03-05 20:00:05 +0000");
    EXPECT_EQ(place("2024-03-06T01:30:05-01:00"), "2024-03-06 02:30:05 +0000");
}

TEST_F(ReplayPointTest, TimeOfDayIsTheFirstFromTheRecordingsStartOn)
{
    EXPECT_EQ(place("14:07:31"), "2024-03-05 14:07:31 +0000");
    EXPECT_EQ(place("14:07:30"), "2024-03-06 14:07:30 +0000");
    EXPECT_EQ(place("15:00"), "2024-03-05 15:00:00 +0000");
    clock.setZone({-36000, false}); // 04:07:31 there
    EXPECT_EQ(place("04:08"), "2024-03-05 14:08:00 +0000");
    EXPECT_EQ(place("14:08Z"), "2024-03-05 14:08:00 +0000");
    clock.setZone({46800, false}); // 03:07:31 of the next day
    EXPECT_EQ(place("03:08"), "2024-03-05 14:08:00 +0000");
}

TEST_F(ReplayPointTest, FractionsCountToTheMicrosecond)
{
    const auto point = ReplayPoint::wallClock("14:07:31.25");
    ASSERT_TRUE(point);
    EXPECT_EQ(point->in(FakeRunLoop::Start, clock) - FakeRunLoop::Start, std::chrono::milliseconds(250));
}

TEST_F(ReplayPointTest, AnythingElseIsNone)
{
    for (const char* text : {"", "soon", "14", "14:7", "24:00", "14:60", "14:07:61", "2024-13-01 00:00",
             "2023-02-29 00:00", "2024-03-05", "2024-03-05 14:07:31 CET", "14:07:31 +25:00", "14:07:31Z!", "-1:00"})
        EXPECT_EQ(place(text), "none") << text;
}

} // namespace
} // namespace spectrel
