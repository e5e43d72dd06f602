#include "Platform/Clock.h"
#include "Values/Moment.h"

#include <gtest/gtest.h>

namespace spectrel {

namespace {

Moment seconds(std::int64_t count)
{
    return Moment(std::chrono::seconds(count));
}

} // namespace

TEST(ClockTest, DefaultDateFormIsInUTCToTheSecond)
{
    EXPECT_EQ(defaultDateForm(seconds(1709647651)), "2024-03-05 14:07:31 +0000");
    EXPECT_EQ(defaultDateForm(seconds(1709647651) + std::chrono::microseconds(999999)), "2024-03-05 14:07:31 +0000");
    EXPECT_EQ(defaultDateForm(seconds(0)), "1970-01-01 00:00:00 +0000");
    EXPECT_EQ(defaultDateForm(seconds(0) - std::chrono::microseconds(1)), "1969-12-31 23:59:59 +0000");
}

TEST(ClockTest, DefaultDateFormReadsBack)
{
    for (const std::int64_t count : {0l, 1709647651l, 951782400l, 4107542399l, -1l}) {
        Moment moment;
        ASSERT_TRUE(parseDefaultDateForm(defaultDateForm(seconds(count)), moment)) << count;
        EXPECT_EQ(moment, seconds(count));
    }
}

TEST(ClockTest, OffsetFromUTCIsTakenOff)
{
    Moment moment;
    ASSERT_TRUE(parseDefaultDateForm("2024-03-05 15:37:31 +0130", moment));
    EXPECT_EQ(moment, seconds(1709647651));
    ASSERT_TRUE(parseDefaultDateForm("2024-03-05 09:07:31 -0500", moment));
    EXPECT_EQ(moment, seconds(1709647651));
}

TEST(ClockTest, OtherFormsAreRefusedAndLeaveTheMoment)
{
    for (const char* text : {"", "2024-03-05", "2024-03-05 14:07:31", "2024-03-05T14:07:31 +0000",
             " 2024-03-05 14:07:31 +0000", "2024-03-05 14:07:31 +0000 ", "2024-3-5 14:07:31 +0000",
             "2024-13-05 14:07:31 +0000", "2023-02-29 14:07:31 +0000", "2024-03-05 24:07:31 +0000",
             "2024-03-05 14:60:31 +0000", "2024-03-05 14:07:60 +0000", "2024-03-05 14:07:31 *0000",
             "2024-03-05 14:07:31 +0060", "2024-03- 5 14:07:31 +0000", "2024-03-05 -4:07:31 +0000",
             "+024-03-05 14:07:31 +0000", "2024-00-05 14:07:31 +0000"}) {
        Moment moment = seconds(7);
        EXPECT_FALSE(parseDefaultDateForm(text, moment)) << text;
        EXPECT_EQ(moment, seconds(7)) << text;
    }
}

TEST(ClockTest, UTCIsTheSystemsTimeWithoutAZone)
{
    EXPECT_GT(Clock::utc().now(), seconds(1'600'000'000));
    EXPECT_EQ(Clock::utc().zoneAt(seconds(0)).secondsEastOfUTC, 0);
}

} // namespace spectrel
