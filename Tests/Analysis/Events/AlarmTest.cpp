#include "Analysis/Events/Alarm.h"

#include "Analysis/Events/Thresholds.h"
#include "Tests/Analysis/Events/LTEEvents.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

TEST(ParseAlarmTest, ALevelAComparisonANumberAndATime)
{
    const auto alarm = parseAlarm("RSRP < -110 for 10s");
    ASSERT_TRUE(alarm);
    EXPECT_EQ(alarm->level, Level::RSRP);
    EXPECT_EQ(alarm->op, AlarmCondition::Operator::Less);
    EXPECT_EQ(alarm->number, -110);
    EXPECT_EQ(alarm->time, 10s);
    EXPECT_EQ(alarm->text, "RSRP < -110 for 10s");
}

TEST(ParseAlarmTest, BlanksAndTheTimeMayBeLeftOut)
{
    const auto alarm = parseAlarm("EcNo>=-14.5");
    ASSERT_TRUE(alarm);
    EXPECT_EQ(alarm->op, AlarmCondition::Operator::GreaterOrEqual);
    EXPECT_EQ(alarm->number, -14.5);
    EXPECT_EQ(alarm->time, 0s);
}

TEST(ParseAlarmTest, APathStandsInQuotes)
{
    const auto alarm =
        parseAlarm("\"/Serving Cell Measurements/Num of Consecutive DRX Cycles of S < 0\" != 0 for 1.5m");
    ASSERT_TRUE(alarm);
    EXPECT_FALSE(alarm->level);
    EXPECT_EQ(alarm->path, "/Serving Cell Measurements/Num of Consecutive DRX Cycles of S < 0");
    EXPECT_EQ(alarm->op, AlarmCondition::Operator::NotEqual);
    EXPECT_EQ(alarm->time, 90s);
    EXPECT_TRUE(parseAlarm("'/A/B' == 3"));
}

TEST(ParseAlarmTest, AnythingElseIsNone)
{
    for (const char* text : {"", "RSRP", "RSRP <", "RSRP < low", "Power < 3", "RSRP = 3", "RSRP =< 3", "RSRP < 3 s",
             "RSRP < 3 for", "RSRP < 3 for 10", "RSRP < 3 for 10d", "RSRP < 3 for -1s", "RSRP < 3 for 10s now",
             "RSRP < nan", "RSRP < inf", "rsrp < 3", "\"A/B\" < 3", "\"/A/B < 3", "/A/B < 3"})
        EXPECT_FALSE(parseAlarm(text)) << text;
}

TEST(AlarmConditionTest, EachComparison)
{
    const auto isMet = [](const std::string& op, double value) {
        return parseAlarm("C1 " + op + " 5")->isMetBy(value);
    };
    EXPECT_TRUE(isMet("<", 4) && !isMet("<", 5));
    EXPECT_TRUE(isMet("<=", 5) && !isMet("<=", 6));
    EXPECT_TRUE(isMet(">", 6) && !isMet(">", 5));
    EXPECT_TRUE(isMet(">=", 5) && !isMet(">=", 4));
    EXPECT_TRUE(isMet("==", 5) && !isMet("==", 4));
    EXPECT_TRUE(isMet("!=", 4) && !isMet("!=", 5));
}

class AlarmWatchTest : public LTEEvents, private AlarmListener {
protected:
    void watch(const char* text)
    {
        _watch.emplace(*parseAlarm(text), analysis, static_cast<AlarmListener&>(*this));
    }
    std::vector<Event> raised;

private:
    void alarmRaised(const AlarmCondition&, const Event& event) override
    {
        raised.push_back(event);
    }
    std::optional<AlarmWatch> _watch;
};

TEST_F(AlarmWatchTest, IsRaisedOnceTheConditionHasHeldForItsTime)
{
    watch("RSRP < -110 for 3s");
    idle(A, 10, -112);
    at(2s);
    idle(A, 10, -113);
    EXPECT_TRUE(raised.empty());
    at(3s);
    idle(A, 10, -114);
    at(4s);
    idle(A, 10, -115);
    ASSERT_EQ(raised.size(), 1u);
    EXPECT_EQ(raised[0].n, 2u);
    EXPECT_EQ(raised[0].time, Start + 3s);
    EXPECT_EQ(raised[0].condition, "RSRP < -110 for 3s");
    EXPECT_EQ(raised[0].value, -114);
}

TEST_F(AlarmWatchTest, ABetterValueInBetweenBeginsAnew)
{
    watch("RSRP < -110 for 3s");
    idle(A, 10, -112);
    at(2s);
    idle(A, 10, -110);
    at(3s);
    idle(A, 10, -112);
    at(5s);
    idle(A, 10, -112);
    EXPECT_TRUE(raised.empty());
    at(6s);
    idle(A, 10, -112);
    EXPECT_EQ(raised.size(), 1u);
}

TEST_F(AlarmWatchTest, IsRaisedAgainAfterTheConditionDidNotHold)
{
    watch("RSRP < -110");
    for (const double rsrp : {-112.0, -113.0, -100.0, -112.0})
        idle(A, 10, rsrp);
    EXPECT_EQ(raised.size(), 2u);
}

TEST_F(AlarmWatchTest, TimePassesAtMessagesOfOtherThings)
{
    watch("RSRP < -110 for 3s");
    idle(A, 10, -112);
    at(3s);
    neighbour(B, -100);
    EXPECT_EQ(raised.size(), 1u);
}

TEST_F(AlarmWatchTest, APathIsReadFromTheTree)
{
    watch("'/Serving Cell Measurements/Srxlev' <= 4");
    idle(A, 5);
    EXPECT_TRUE(raised.empty());
    idle(A, 4);
    ASSERT_EQ(raised.size(), 1u);
    EXPECT_EQ(raised[0].value, 4);
}

TEST_F(AlarmWatchTest, WhatIsNotKnownRaisesNothing)
{
    watch("RSCP != 0");
    idle(A, 5);
    EXPECT_TRUE(raised.empty());
}

TEST(ThresholdsTest, AreSetByNameWithinTheirRange)
{
    Thresholds thresholds;
    EXPECT_EQ(thresholds[Threshold::PingPongTime], 10);
    EXPECT_TRUE(thresholds.set("ping-pong-time=20.5"));
    EXPECT_EQ(thresholds[Threshold::PingPongTime], 20.5);
    for (const char* text : {"", "ping-pong-time", "ping-pong-time=", "ping-pong-time=x", "ping-pong-time=5s",
             "ping-pong-time=-1", "ping-pong-time=nan", "ping-pong=5"})
        EXPECT_FALSE(thresholds.set(text)) << text;
    EXPECT_EQ(thresholds[Threshold::PingPongTime], 20.5);
}

} // namespace
} // namespace spectrel
