#include "Tests/Fakes/FakePlayback.h"
#include "Tests/UI/Terminal/TerminalFixture.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class PlaybackViewTest : public TerminalFixture {
protected:
    PlaybackViewTest()
    {
        playing = &playback;
        screen.resize(80, 7);
    }
    ~PlaybackViewTest() override
    {
        app.reset(); // before the playback
    }
    void open()
    {
        start();
        show(numbered(30));
    }

    FakePlayback playback;
};

TEST_F(PlaybackViewTest, TheLineBelowThePaneTellsThePlaceAndDrawsIt)
{
    open();
    playback.here = 45s;
    playback.applied = 50;
    EXPECT_EQ(line(4), " Row 3                                                                        30");
    EXPECT_EQ(line(5), " Updated 2024-03-05 at 14:07:31");
    EXPECT_EQ(line(6), " ‖ paused  00:45.000 / 01:30.000  message 50 of 100  ━━━━━━━━━━━━━─────────────");
    playback.plays = true;
    EXPECT_THAT(line(6), testing::StartsWith(" ▶ playing  00:45.000"));
}

TEST_F(PlaybackViewTest, InANarrowWindowTheMostImportantStays)
{
    open();
    screen.resize(30, 7);
    EXPECT_EQ(line(6), " ‖ paused  ──────────────────");
    screen.resize(14, 7);
    EXPECT_EQ(line(6), " ‖ paused");
}

TEST_F(PlaybackViewTest, TheSmallestWindowsHaveOnlyThePane)
{
    open();
    screen.resize(80, 3);
    EXPECT_EQ(line(2), " Updated 2024-03-05 at 14:07:31");
}

TEST_F(PlaybackViewTest, ItsKeysMoveOnTheTimeLine)
{
    open();
    playback.here = 20s;
    type(U"  .,][><+-05$");
    EXPECT_EQ(playback.calls,
        "play pause message+ message- tick+ tick- seek 30000 seek 10000 speed 2 speed 1 seek 0 seek 45000 seek 90000 ");
}

TEST_F(PlaybackViewTest, ThePanesKeysStayThePanes)
{
    open();
    press(Key::Down, 2);
    EXPECT_EQ(cursorLine(), 3);
    press(Key::PageDown);
    EXPECT_EQ(playback.calls, "");
}

TEST_F(PlaybackViewTest, APressOnTheBarSeeksAndOneBesideItPlays)
{
    open();
    screen.draw();
    click(78, 6);
    click(52, 6);
    click(2, 6);
    EXPECT_EQ(playback.calls, "seek 90000 seek 0 play ");
}

TEST_F(PlaybackViewTest, WhatWentWrongIsToldBesideTheStatus)
{
    open();
    playback.noticeNow = "message 7 (no code) would have ended the program";
    EXPECT_EQ(line(5), " Updated 2024-03-05 at 14:07:31  message 7 (no code) would have ended the progra");
    type(U"y");
    EXPECT_THAT(line(5), testing::HasSubstr("Copied")) << "the latest news comes first";
}

TEST_F(PlaybackViewTest, WhereNothingIsPlayedItsKeysDoNothing)
{
    playing = nullptr;
    open();
    type(U" .5");
    EXPECT_EQ(playback.calls, "");
    EXPECT_EQ(line(6), " Updated 2024-03-05 at 14:07:31");
}

} // namespace
} // namespace spectrel
