#include "Tests/Analysis/Events/LTEEvents.h"

#include <gmock/gmock.h>

namespace spectrel {
namespace {

using namespace std::chrono_literals;
using testing::ElementsAre;

using LTEMovesTest = LTEEvents;

TEST_F(LTEMovesTest, TheFirstCellIsAnEventWithoutFrom)
{
    idle(A, 20);
    EXPECT_TRUE(events.empty()); // it is not settled yet
    at(7s);
    idle(A, 20);
    ASSERT_EQ(events.size(), 1u);
    EXPECT_EQ(events[0].kind, EventKind::Cell);
    EXPECT_FALSE(events[0].fromCell);
    EXPECT_FALSE(events[0].cause);
    EXPECT_EQ(events[0].n, 0u);
    EXPECT_EQ(events[0].time, Start);
    EXPECT_EQ(events[0].toCell->id, 52u);
}

TEST_F(LTEMovesTest, RecordsOfTheSameCellAreNoMove)
{
    serve(A, 0x100001);
    idle(A, 20);
    at(3s);
    connected(A);
    idle(A, 18);
    finish();
    EXPECT_TRUE(moves().empty());
}

TEST_F(LTEMovesTest, AMoveIsReportedOnceAtTheFirstMessageThatShowsIt)
{
    serve(A, 0x100001);
    idle(A, 20);
    at(10s);
    idle(B, 30, -90);
    pass(400ms);
    serve(B, 0x100101);
    pass(5s);
    serve(B, 0x100101);
    at(17s);
    idle(B, 30, -95);
    const auto found = moves();
    ASSERT_EQ(found.size(), 1u);
    EXPECT_EQ(found[0].n, 2u);
    EXPECT_EQ(found[0].time, Start + 10s);
    EXPECT_EQ(found[0].fromCell->cell, 0x100001u);
    EXPECT_EQ(found[0].toCell->cell, 0x100101u); // told by a later message
    EXPECT_EQ(found[0].toCell->level(Level::RSRP), -90); // the first one
    EXPECT_THAT(found[0].change, ElementsAre("id", "cell"));
}

TEST_F(LTEMovesTest, WhatWasNotStoredSinceTheMoveIsNotKnownOfTheNewCell)
{
    serve(A, 0x100001);
    at(10s);
    connected(B);
    at(20s);
    connected(B);
    const auto found = moves();
    ASSERT_EQ(found.size(), 1u);
    EXPECT_FALSE(found[0].toCell->cell);
    EXPECT_FALSE(found[0].toCell->area);
    EXPECT_THAT(found[0].change, ElementsAre("id"));
}

TEST_F(LTEMovesTest, LaterEventsWaitForTheMove)
{
    serve(A, 0x100001);
    at(10s);
    serve(B, 0x100101, 1202);
    idle(B, 20);
    pass(1s);
    connected(B);
    EXPECT_EQ(all(EventKind::Area).size(), 0u);
    at(17s);
    connected(B);
    ASSERT_EQ(events.size(), 4u);
    EXPECT_EQ(events[1].kind, EventKind::Cell);
    EXPECT_EQ(events[2].kind, EventKind::Area);
    EXPECT_EQ(events[2].from, "1201");
    EXPECT_EQ(events[2].to, "1202");
    EXPECT_EQ(events[3].kind, EventKind::Connection);
    EXPECT_EQ(events[3].to, "connected");
}

TEST_F(LTEMovesTest, ASecondMoveSettlesTheFirst)
{
    idle(A, 20);
    at(10s);
    idle(B, 20);
    pass(1s);
    idle(A, 20);
    finish();
    const auto found = moves();
    ASSERT_EQ(found.size(), 2u);
    EXPECT_EQ(found[0].toCell->id, 203u);
    EXPECT_EQ(found[1].toCell->id, 52u);
}

TEST_F(LTEMovesTest, TheCellBeforeAMoveHasTheLevelsLastKnown)
{
    idle(A, 20, -100);
    at(9s);
    idle(A, 18, -104);
    at(10s);
    idle(B, 20, -90);
    finish();
    ASSERT_EQ(moves().size(), 1u);
    EXPECT_EQ(moves()[0].fromCell->level(Level::RSRP), -104);
}

TEST_F(LTEMovesTest, AMoveInAConnectionIsAHandover)
{
    connected(A);
    at(1s);
    connected(B);
    finish();
    EXPECT_EQ(causeOfMove(), "handover");
    EXPECT_EQ(moves()[0].cause->evidence.size(), 1u);
}

TEST_F(LTEMovesTest, AnIdleMoveIsAReselectionThoughAConnectionFollows)
{
    idle(A, 20);
    at(1s);
    serve(B, 0x100101);
    pass(100ms);
    connected(B);
    finish();
    EXPECT_EQ(causeOfMove().substr(0, 11), "reselection");
}

TEST_F(LTEMovesTest, WithoutAStateTheCauseIsUnknown)
{
    serve(A, 0x100001);
    at(1s);
    serve(B, 0x100101);
    finish();
    EXPECT_EQ(causeOfMove(), "unknown");
}

TEST_F(LTEMovesTest, ACandidateOfAHigherPriorityWasTaken)
{
    for (const auto offset : {0ms, 1200ms, 2400ms}) {
        at(offset);
        idle(Low, 20);
        candidate(Low, A);
    }
    at(3600ms);
    idle(A, 30);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection higher-priority");
    EXPECT_THAT(moves()[0].cause->text, testing::HasSubstr("5 against 4"));
    EXPECT_THAT(moves()[0].cause->text, testing::HasSubstr("a candidate for 3.6 s"));
}

TEST_F(LTEMovesTest, AWeakCellIsLeftForALowerPriority)
{
    idle(A, 8);
    candidate(A, Low);
    at(1200ms);
    idle(Low, 20);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection lower-priority");
}

TEST_F(LTEMovesTest, AStrongCellIsNotLeftForALowerPrioritySoTheRuleIsUnknown)
{
    idle(A, 40); // above its search threshold of 20 dB
    candidate(A, Low);
    at(1200ms);
    idle(Low, 20);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection unknown");
}

TEST_F(LTEMovesTest, OnOneCarrierTheStrongerCellIsTaken)
{
    idle(A, 20, -100);
    neighbour(B, -92);
    at(1200ms);
    idle(B, 30, -92);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection equal-priority");
}

TEST_F(LTEMovesTest, OnOneCarrierAWeakerCellSpeaksForNoRule)
{
    idle(A, 20, -100);
    neighbour(B, -108);
    at(1200ms);
    idle(B, 14, -108);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection unknown");
}

TEST_F(LTEMovesTest, ACellThatIsNoLongerSuitableIsLeft)
{
    idle(A, -3, -125, 3);
    at(1200ms);
    idle(B, 5, -117);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection not-suitable");
}

TEST_F(LTEMovesTest, OneCycleBelowZeroIsNotEnoughToBeUnsuitable)
{
    idle(A, -3, -125, 1);
    at(1200ms);
    idle(B, 5, -117);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection unknown");
}

TEST_F(LTEMovesTest, WhatWasMeasuredLongAgoSpeaksForNoRule)
{
    idle(Low, 20);
    candidate(Low, A);
    at(6s);
    idle(A, 30);
    finish();
    EXPECT_EQ(causeOfMove(), "reselection unknown");
}

TEST_F(LTEMovesTest, ServiceIsLostWhenTenSecondsOfOtherMessagesTellOfNoCell)
{
    idle(A, 20);
    for (const auto offset : {4s, 8s, 10s}) {
        at(offset);
        neighbour(B, -120);
    }
    EXPECT_TRUE(all(EventKind::ServiceLost).empty());
    at(11s);
    neighbour(B, -120);
    ASSERT_EQ(all(EventKind::ServiceLost).size(), 1u);
    EXPECT_EQ(all(EventKind::ServiceLost)[0].cell->id, 52u);
    at(30s);
    idle(B, 20);
    finish();
    EXPECT_EQ(causeOfMove(), "service-lost");
    const auto back = all(EventKind::ServiceBack);
    ASSERT_EQ(back.size(), 1u);
    EXPECT_EQ(back[0].cell->id, 203u);
    EXPECT_EQ(back[0].seconds, 30);
}

TEST_F(LTEMovesTest, APauseBetweenMessagesIsNoLossOfService)
{
    idle(A, 20);
    at(60s);
    neighbour(B, -120);
    pass(1s);
    idle(A, 20);
    finish();
    EXPECT_TRUE(all(EventKind::ServiceLost).empty());
}

TEST_F(LTEMovesTest, ConnectionChangesAreEventsAndTheFirstStateIsNone)
{
    idle(A, 20);
    at(1s);
    connected(A);
    pass(200ms);
    connected(A);
    pass(200ms);
    idle(A, 20);
    finish();
    const auto found = all(EventKind::Connection);
    ASSERT_EQ(found.size(), 2u);
    EXPECT_EQ(found[0].from, "idle");
    EXPECT_EQ(found[0].to, "connected");
    EXPECT_EQ(found[0].n, 1u);
    EXPECT_EQ(found[1].to, "idle");
}

TEST_F(LTEMovesTest, AnEventOfSomebodyElseKeepsItsPlace)
{
    idle(A, 20);
    at(10s);
    idle(B, 20);
    Event alarm;
    alarm.kind = EventKind::Alarm;
    finder.add(alarm);
    EXPECT_TRUE(all(EventKind::Alarm).empty());
    finish();
    EXPECT_EQ(events.back().kind, EventKind::Alarm);
}

TEST_F(LTEMovesTest, ABookmarkStandsBeforeTheFirstLaterMessage)
{
    finder.addBookmark(Start + 3s, "tunnel");
    serve(A, 0x100001);
    at(10s);
    serve(A, 0x100001, 1202);
    ASSERT_EQ(events.size(), 3u);
    EXPECT_EQ(events[1].kind, EventKind::Bookmark);
    EXPECT_EQ(events[1].note, "tunnel");
    EXPECT_EQ(events[1].time, Start + 3s);
    EXPECT_EQ(events[1].n, 1u);
    EXPECT_EQ(events[2].kind, EventKind::Area);
}

TEST_F(LTEMovesTest, ASessionThatIsLostAndBackIsToldTheFirstOneIsNot)
{
    finder.sessionDidChange(true, "", Start);
    EXPECT_TRUE(events.empty());
    finder.sessionDidChange(false, "no reply", Start + 5s);
    finder.sessionDidChange(false, "no service", Start + 10s);
    finder.sessionDidChange(true, "", Start + 15s);
    ASSERT_EQ(events.size(), 2u);
    EXPECT_EQ(events[0].kind, EventKind::SessionLost);
    EXPECT_EQ(events[0].reason, "no reply");
    EXPECT_EQ(events[1].kind, EventKind::SessionBack);
    EXPECT_EQ(events[1].time, Start + 15s);
}

} // namespace
} // namespace spectrel
