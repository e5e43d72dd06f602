#include "Tests/Fakes/FakePlayback.h"
#include "Tests/UI/Quick/QuickFixture.h"
#include "UI/AboutText.h"

#include <QClipboard>
#include <QGuiApplication>
#include <QQuickItem>
#include <QQuickWindow>
#include <QTest>

#include <utility>

namespace spectrel {
namespace {

/// Find, copy, about and the playback line: what the title bar and the keyboard offer beyond the rows.
class ToolsTest : public QuickFixture {
protected:
    void openWithTree()
    {
        open();
        show(entries({{"Cells", entries({{"Serving", entries({{"PCI", "17"}, {"EARFCN", "1300"}})}})}, {"Band", "3"}}));
        ASSERT_TRUE(waitFor([this] { return row(1); }));
    }
    void openFind()
    {
        touch(item("findButton"));
        ASSERT_TRUE(waitFor([this] { return item("findField") && item("findField")->hasActiveFocus(); }));
    }
    void chooseFromMenu(const char* action)
    {
        ASSERT_TRUE(waitFor([this, action] { return item(action); }));
        waitForFrame();
        touch(item(action));
    }
    void waitUntilFindIsClosed()
    {
        EXPECT_TRUE(waitFor([this] { return !item("findField"); }));
    }
    static std::string clipboard()
    {
        return QGuiApplication::clipboard()->text().toStdString();
    }
};

TEST_F(ToolsTest, FindFiltersWhileTypingAndOpensThePaneOfTheRowTouched)
{
    openWithTree();
    openFind();
    type("130");
    ASSERT_TRUE(waitFor([this] { return item("find"); }));
    EXPECT_EQ(shownText("findCount"), "1 found");
    EXPECT_EQ(shownText("findName"), "EARFCN");
    touch(item("find"));
    waitUntilFindIsClosed();
    settle();
    EXPECT_EQ(openPaths(), "/ /Cells /Cells/Serving ");
    EXPECT_EQ(shownText("title"), "Serving");
    EXPECT_EQ(list()->property("currentIndex").toInt(), 1);
}

TEST_F(ToolsTest, FindWorksByKeyboardAlone)
{
    openWithTree();
    key(Qt::Key_F, Qt::ControlModifier);
    ASSERT_TRUE(waitFor([this] { return item("findField") && item("findField")->hasActiveFocus(); }));
    type("c");
    EXPECT_EQ(shownText("findCount"), "3 found"); // Cells, PCI, EARFCN
    key(Qt::Key_Down);
    key(Qt::Key_Return);
    waitUntilFindIsClosed();
    settle();
    EXPECT_EQ(openPaths(), "/ /Cells /Cells/Serving ");
    key(Qt::Key_Escape);
    settle();
    EXPECT_EQ(openPaths(), "/ /Cells "); // the pane has the keyboard again
}

TEST_F(ToolsTest, FindThatIsClosedOpensNothing)
{
    openWithTree();
    openFind();
    type("pci");
    key(Qt::Key_Escape);
    waitUntilFindIsClosed();
    EXPECT_EQ(openPaths(), "/ ");
    openFind();
    EXPECT_EQ(shownText("findField"), "");
    EXPECT_EQ(shownText("findCount"), "");
    touch(item("findBack"));
    waitUntilFindIsClosed();
}

TEST_F(ToolsTest, SwipeFromTheEdgeClosesTheSearch)
{
    openWithTree();
    openFind();
    type("pci");
    drag(QPointF(4, 400), {160, 0});
    waitUntilFindIsClosed();
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(ToolsTest, FindsFollowTheTree)
{
    openWithTree();
    openFind();
    type("1");
    EXPECT_EQ(shownText("findCount"), "2 found");
    show(entries({{"Band", "1"}}));
    EXPECT_EQ(shownText("findCount"), "1 found");
    EXPECT_TRUE(waitFor([this] { return shownText("findName") == "Band"; }));
    key(Qt::Key_Escape);
    waitUntilFindIsClosed();
}

TEST_F(ToolsTest, MenuCopiesTheWholePaneAndSaysSo)
{
    openWithTree();
    touch(item("menuButton"));
    chooseFromMenu("copyPane");
    EXPECT_EQ(clipboard(), "Cells\n  Serving\n    PCI: 17\n    EARFCN: 1300\nBand: 3\n");
    EXPECT_EQ(shownText("toastText"), "Copied 5 lines");
    EXPECT_TRUE(waitFor([this] { return !item("toast"); }));
    EXPECT_EQ(app->copying()->message(), "");
}

TEST_F(ToolsTest, HoldingARowOffersToCopyItsValue)
{
    openWithTree();
    const QPointF finger = press(row(1));
    ASSERT_TRUE(waitFor([this] { return item("copyRow"); }));
    release(finger);
    chooseFromMenu("copyRow");
    EXPECT_EQ(clipboard(), "3");
    EXPECT_EQ(shownText("toastText"), "Copied the value of Band");
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(ToolsTest, CopyKeyTakesTheKeyboardsRow)
{
    openWithTree();
    key(Qt::Key_Down);
    key(Qt::Key_Down);
    key(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(clipboard(), "3");
}

TEST_F(ToolsTest, AboutSaysWhatItIs)
{
    openWithTree();
    touch(item("menuButton"));
    chooseFromMenu("about");
    ASSERT_TRUE(waitFor([this] { return item("aboutClose"); }));
    EXPECT_EQ(shownText("aboutName"), AboutText::text().name);
    EXPECT_EQ(shownText("aboutVersion"), AboutText::text().version);
    const auto middle = [this](const char* name) { return item(name)->mapToScene({item(name)->width() / 2, 0}).x(); };
    EXPECT_NEAR(middle("aboutMark"), middle("aboutName"), 1);
    touch(item("aboutClose"));
    EXPECT_TRUE(waitFor([this] { return !item("aboutClose"); }));
}

class PlaybackLineTest : public ToolsTest {
protected:
    void SetUp() override
    {
        ToolsTest::SetUp();
        recording.here = std::chrono::seconds(36);
        playing = &recording;
        openWithTree();
    }
    std::string takeCalls()
    {
        return std::exchange(recording.calls, {});
    }

    FakePlayback recording;
};

TEST_F(PlaybackLineTest, ShowsWhereTheScreensStand)
{
    EXPECT_EQ(shownText("playbackTime"), "00:36.000 / 01:30.000");
    EXPECT_EQ(shownText("playbackState"), "paused");
    EXPECT_DOUBLE_EQ(item("playbackLine")->property("value").toDouble(), 0.4);
    recording.here = std::chrono::seconds(63);
    recording.plays = true;
    recording.speedNow = 4;
    app->playbackDidChange();
    EXPECT_EQ(shownText("playbackTime"), "01:03.000 / 01:30.000");
    EXPECT_EQ(shownText("playbackState"), "playing 4x");
    EXPECT_DOUBLE_EQ(item("playbackLine")->property("value").toDouble(), 0.7);
}

TEST_F(PlaybackLineTest, ButtonsPlayStepSeekAndChangeTheSpeed)
{
    for (const char* button :
        {"play", "play", "stepForward", "stepBack", "seekForward", "seekBack", "faster", "slower"})
        touch(item(button));
    EXPECT_EQ(takeCalls(), "play pause message+ message- seek 46000 seek 26000 speed 2 speed 1 ");
}

TEST_F(PlaybackLineTest, ItsButtonsAreInSightAndLargeEnoughOnTheSmallestPhone)
{
    window().resize(320, 480);
    ASSERT_TRUE(waitFor([this] { return page()->width() == 320; }));
    waitForFrame();
    for (const char* name :
        {"play", "stepForward", "stepBack", "seekForward", "seekBack", "faster", "slower", "playbackLine"}) {
        const QPointF corner = item(name)->mapToScene({0, 0});
        EXPECT_GE(corner.x(), 0) << name;
        EXPECT_LE(corner.x() + item(name)->width(), 320) << name;
        EXPECT_GE(item(name)->width(), 44) << name;
        EXPECT_GE(item(name)->height(), 44) << name;
    }
}

TEST_F(PlaybackLineTest, DraggingTheLineSeeksAndLeavesItFollowing)
{
    drag(item("playbackLine"), {100, 0});
    EXPECT_THAT(takeCalls(), testing::StartsWith("seek "));
    recording.here = std::chrono::seconds(9);
    app->playbackDidChange();
    EXPECT_DOUBLE_EQ(item("playbackLine")->property("value").toDouble(), 0.1);
}

TEST_F(PlaybackLineTest, KeysAreThoseOfTheTerminal)
{
    key(Qt::Key_Space);
    type(",.[]<>3+");
    EXPECT_EQ(takeCalls(), "play message- message+ tick- tick+ seek 26000 seek 46000 seek 27000 speed 2 ");
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(PlaybackLineTest, WhatWentWrongIsToldOnce)
{
    recording.noticeNow = "message 3 ends the program";
    app->playbackDidChange();
    EXPECT_EQ(shownText("toastText"), "message 3 ends the program");
    EXPECT_TRUE(waitFor([this] { return !item("toast"); }));
    app->playbackDidChange();
    EXPECT_EQ(item("toast"), nullptr);
}

TEST_F(ToolsTest, LiveSessionHasNoPlaybackLine)
{
    openWithTree();
    EXPECT_EQ(item("play"), nullptr);
}

} // namespace
} // namespace spectrel
