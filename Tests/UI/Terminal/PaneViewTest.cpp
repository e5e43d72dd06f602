#include "Tests/UI/Terminal/TerminalFixture.h"

namespace spectrel {
namespace {

using namespace std::chrono_literals;

class PaneViewTest : public TerminalFixture { };

TEST_F(PaneViewTest, ARootPaneShowsTitleRowsAndStatus)
{
    start();
    show(entries({{"Serving Cell Info", entries({})}, {"State", "Idle"}}));
    EXPECT_EQ(text(),
        " Spectrel                        ? help\n"
        " Serving Cell Info                     ›\n"
        " State                              Idle\n"
        "\n"
        "\n"
        "\n"
        " Updated 2024-03-05 at 14:07:31\n");
    EXPECT_EQ(styles(),
        "MMMMMMMMMMMMMMMMMMMMMMMMMMMMMMMMMRRRRRRM\n"
        "RMMMMMMMMMMMMMMMMMRRRRRRRRRRRRRRRRRRRRRR\n"
        ".BBBBB..................................\n"
        "........................................\n"
        "........................................\n"
        "........................................\n"
        "........................................\n");
}

TEST_F(PaneViewTest, BeforeTheFirstTreeThereIsOnlyTheSpinner)
{
    start();
    EXPECT_EQ(line(0), " Spectrel                        ? help");
    EXPECT_EQ(line(1), "");
    EXPECT_EQ(line(6), " | Connecting");
    EXPECT_TRUE(screen.isAnimating());
    screen.advanceSpinner();
    EXPECT_EQ(line(6), " / Connecting");
}

TEST_F(PaneViewTest, TheSpinnerRestsOnceThereIsADisplay)
{
    start();
    show(entries({}));
    EXPECT_FALSE(screen.isAnimating());
    lose("");
    EXPECT_TRUE(screen.isAnimating());
}

TEST_F(PaneViewTest, ALostSessionShowsItsReasonAfterTheStatus)
{
    start();
    show(entries({{"State", "Idle"}}));
    screen.resize(60, 7);
    lose("Could not create RKServerConnection");
    EXPECT_EQ(line(6), " | Connecting...  Could not create RKServerConnection");
}

TEST_F(PaneViewTest, EnterOpensAndBackspaceGoesBack)
{
    start();
    show(entries({{"A", entries({{"B", "1"}})}}));
    press(Key::Enter);
    EXPECT_EQ(line(0), "‹ A                                  /A");
    EXPECT_EQ(line(1), " B                                     1");
    press(Key::Backspace);
    EXPECT_EQ(line(0), " Spectrel                        ? help");
    press(Key::Backspace);
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(PaneViewTest, RightOpensAndLeftAndEscapeGoBack)
{
    start();
    show(entries({{"A", entries({{"B", entries({})}})}}));
    press(Key::Right, 2);
    EXPECT_EQ(openPaths(), "/ /A /A/B ");
    press(Key::Left);
    press(Key::Escape);
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(PaneViewTest, ThePathIsLeftOutWhereItDoesNotFit)
{
    start();
    const std::string name(30, 'n');
    show(entries({{name, entries({})}}));
    press(Key::Enter);
    EXPECT_EQ(line(0), "‹ " + name);
}

TEST_F(PaneViewTest, TheCursorMovesByRowsPagesAndToTheEnds)
{
    start();
    show(numbered(20));
    EXPECT_EQ(cursorLine(), 1);
    press(Key::Down, 2);
    EXPECT_EQ(cursorLine(), 3);
    type(U"jk");
    press(Key::Up);
    EXPECT_EQ(cursorLine(), 2);
    press(Key::End);
    EXPECT_EQ(line(5), " Row 19                              190");
    EXPECT_EQ(cursorLine(), 5);
    press(Key::PageUp);
    EXPECT_EQ(line(1), " Row 15                              150");
    EXPECT_EQ(cursorLine(), 1);
    press(Key::Home);
    EXPECT_EQ(line(1), " Row 0                                 0");
    press(Key::PageDown, 2);
    EXPECT_EQ(line(5), " Row 8                                80");
    press(Key::Up, 100);
    EXPECT_EQ(line(1), " Row 0                                 0");
}

TEST_F(PaneViewTest, ALongValueScrollsSidewaysInItsRow)
{
    start();
    const std::string value = "0123456789abcdefghijklmnopqrstuvwxyz";
    show(entries({{"Key", value}, {"Other", "1"}}));
    EXPECT_EQ(line(1), " Key     0123456789abcdefghijklmnopqrst…");
    press(Key::Right);
    EXPECT_EQ(line(1), "…" + value);
    press(Key::Right, 10);
    EXPECT_EQ(line(1), "…vwxyz"); // it scrolls by the widths of name and value together
}

TEST_F(PaneViewTest, LeftScrollsBackBeforeItGoesBack)
{
    start();
    show(entries({{"A", entries({{"Key", std::string(50, 'x')}})}}));
    press(Key::Enter);
    const std::string before = line(1);
    press(Key::Right);
    EXPECT_NE(line(1), before);
    press(Key::Left);
    EXPECT_EQ(line(1), before);
    EXPECT_EQ(openPaths(), "/ /A ");
    press(Key::Left);
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(PaneViewTest, SidewaysScrollingStaysThroughAReload)
{
    start();
    show(entries({{"Key", std::string(50, 'x')}}));
    line(1);
    type(U"l");
    const std::string scrolled = line(1);
    show(entries({{"Key", std::string(50, 'x')}}));
    EXPECT_EQ(line(1), scrolled);
    type(U"h");
    EXPECT_NE(line(1), scrolled);
}

TEST_F(PaneViewTest, CursorAndPlaceStayThroughReloads)
{
    start();
    show(numbered(20));
    press(Key::Down, 9);
    EXPECT_EQ(line(5), " Row 9                                90");
    show(numbered(30));
    EXPECT_EQ(line(5), " Row 9                                90");
    EXPECT_EQ(cursorLine(), 5);
}

TEST_F(PaneViewTest, TheCursorStaysWithItsRowWhenRowsComeAboveIt)
{
    start();
    show(entries({{"a", "1"}, {"b", "2"}}));
    press(Key::Down);
    show(entries({{"new", "0"}, {"a", "1"}, {"b", "2"}}));
    press(Key::Enter); // a leaf: nothing opens
    EXPECT_EQ(line(cursorLine()), " b                                     2");
}

TEST_F(PaneViewTest, TheCursorStaysInTheListWhenRowsGo)
{
    start();
    show(numbered(20));
    press(Key::End);
    show(numbered(3));
    EXPECT_EQ(line(1), " Row 0                                 0");
    EXPECT_EQ(cursorLine(), 3);
    show(entries({}));
    EXPECT_EQ(cursorLine(), -1);
    press(Key::Enter);
    EXPECT_EQ(openPaths(), "/ ");
}

TEST_F(PaneViewTest, APanesPlaceIsKeptWhileAnotherIsOpenAbove)
{
    start();
    auto display = numbered(10);
    display->set("Inner", entries({{"x", "1"}}));
    show(display);
    press(Key::End);
    press(Key::Enter);
    EXPECT_EQ(cursorLine(), 1);
    show(display);
    press(Key::Backspace);
    EXPECT_EQ(cursorLine(), 5);
    EXPECT_EQ(line(5), " Inner                                 ›");
}

TEST_F(PaneViewTest, APaneWhosePathVanishedGivesWayToTheOneBelow)
{
    start();
    show(entries({{"A", entries({{"B", "1"}})}}));
    press(Key::Enter);
    show(entries({{"C", "2"}}));
    EXPECT_EQ(line(0), " Spectrel                        ? help");
    EXPECT_EQ(line(1), " C                                     2");
}

TEST_F(PaneViewTest, RowsAreUsedAgainOnScreenAsThePoolHandsThemOut)
{
    start();
    show(entries({{"Inner", entries({})}}));
    EXPECT_EQ(line(1), " Inner                                 ›");
    show(entries({{"Leaf", "1"}}));
    EXPECT_EQ(line(1), " Leaf"); // a row made for an inner node has no place for a value
}

TEST_F(PaneViewTest, AClickOnARowOpensItAndOneOnTheTitleGoesBack)
{
    start();
    show(entries({{"Leaf", "1"}, {"A", entries({{"x", "1"}})}}));
    click(5, 1);
    EXPECT_EQ(cursorLine(), 1);
    click(5, 4); // no row there
    EXPECT_EQ(openPaths(), "/ ");
    click(5, 2);
    EXPECT_EQ(openPaths(), "/ /A ");
    click(0, 0);
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(cursorLine(), 2);
}

TEST_F(PaneViewTest, TheWheelScrollsWithTheCursorStayingInSight)
{
    start();
    show(numbered(20));
    wheel(MouseEvent::Action::WheelDown);
    EXPECT_EQ(line(1), " Row 3                                30");
    EXPECT_EQ(cursorLine(), 1);
    wheel(MouseEvent::Action::WheelUp);
    wheel(MouseEvent::Action::WheelUp);
    EXPECT_EQ(line(1), " Row 0                                 0");
    EXPECT_EQ(cursorLine(), 4);
}

TEST_F(PaneViewTest, AWiderWindowLaysTheRowsOutAgain)
{
    start();
    show(entries({{"Key", "value"}}));
    EXPECT_EQ(line(1), " Key                               value");
    screen.resize(20, 5);
    EXPECT_EQ(text(),
        " Spectrel    ? help\n"
        " Key           value\n"
        "\n"
        "\n"
        " Updated 2024-03-05\n");
}

TEST_F(PaneViewTest, ASmallerWindowKeepsTheCursorInSight)
{
    start();
    show(numbered(5));
    press(Key::End);
    screen.resize(40, 4);
    EXPECT_EQ(line(2), " Row 4                                40");
    EXPECT_EQ(cursorLine(), 2);
}

TEST_F(PaneViewTest, NoWindowIsTooSmall)
{
    startAllowingSave();
    lose("a reason");
    show(entries({{"中文", entries({{"Key", std::string(50, 'x')}})}, {"b", "2"}}));
    for (int height = 0; height < 5; ++height) {
        for (int width = 0; width < 12; ++width) {
            screen.resize(width, height);
            screen.draw();
            for (const Key key : {Key::Down, Key::PageDown, Key::Up, Key::Enter, Key::Right, Key::Left, Key::Escape})
                press(key);
            for (int y = 0; y < height; ++y)
                click(width / 2, y);
            type(U"?");
            screen.draw();
            type(U"xs");
            screen.draw();
            type(U"text");
            press(Key::Tab);
            press(Key::Down, 3);
            screen.draw();
            press(Key::Escape);
            loop.runQueued();
            screen.draw();
        }
    }
    screen.resize(1, 1);
    press(Key::Backspace);
    press(Key::Home);
    EXPECT_EQ(text(), "›\n");
}

TEST_F(PaneViewTest, WideCharactersTakeTwoColumnsAndKeepTheValueAtTheEdge)
{
    start();
    show(entries({{"中文", "日本"}, {"e\u0301te\u0301", "x"}}));
    EXPECT_EQ(line(1), " 中文                               日本");
    EXPECT_EQ(line(2), " e\u0301te\u0301" + std::string(35, ' ') + "x");
}

TEST_F(PaneViewTest, NothingInANameOrValueReachesTheTerminalAsACommand)
{
    start();
    show(entries({{"a\x1b[31m", "\a\x7f"},
        {"b\xff\xc0",
            "\xc2\x9b"
            "2J"},
        {"c\u202Ed", "e\u200Bf"}}));
    EXPECT_EQ(line(1), " a␛[31m                               ␇␡");
    EXPECT_EQ(line(2), " b\uFFFD\uFFFD                                 \uFFFD2J");
    EXPECT_EQ(line(3), " c\uFFFDd" + std::string(34, ' ') + "ef");
}

TEST_F(PaneViewTest, TheSaveButtonShowsOnlyWhereSavingIsAllowed)
{
    start();
    show(entries({}));
    EXPECT_EQ(line(6), " Updated 2024-03-05 at 14:07:31");
    type(U"s");
    EXPECT_EQ(app->saveViewController(), nullptr);
    click(36, 6);
    EXPECT_EQ(app->saveViewController(), nullptr);
}

TEST_F(PaneViewTest, AClickOnTheSaveButtonOpensTheSaveScreen)
{
    startAllowingSave();
    show(entries({}));
    EXPECT_EQ(line(6), " Updated 2024-03-05 at 14:07:31  [Save]");
    click(32, 6);
    EXPECT_EQ(app->saveViewController(), nullptr);
    click(33, 6);
    EXPECT_NE(app->saveViewController(), nullptr);
}

TEST_F(PaneViewTest, YCopiesTheRowUnderTheCursorAndCapitalYThePane)
{
    start();
    show(entries({{"Cell", entries({{"ID", "248"}})}, {"State", "Idle"}}));
    press(Key::Down);
    type(U"y");
    EXPECT_EQ(clipboard, "Idle");
    EXPECT_THAT(line(6), testing::HasSubstr("Copied"));
    type(U"Y");
    EXPECT_EQ(clipboard, "Cell\n  ID: 248\nState: Idle\n");
    press(Key::Up);
    EXPECT_THAT(line(6), testing::Not(testing::HasSubstr("Copied"))) << "the next key takes the message away";
}

TEST_F(PaneViewTest, WhatIsTooLongForATerminalIsNotCopied)
{
    start();
    show(entries({{"Long", std::string(TerminalScreen::MaximumCopy + 1, 'x')}}));
    screen.resize(100, 7);
    type(U"y");
    EXPECT_EQ(clipboard, "");
    EXPECT_THAT(line(6), testing::HasSubstr("Not copied: 74995 bytes are too many for a terminal"));
    show(entries({{"Long", std::string(TerminalScreen::MaximumCopy, 'x')}}));
    type(U"y");
    EXPECT_EQ(clipboard.size(), TerminalScreen::MaximumCopy);
}

TEST_F(PaneViewTest, InAnEmptyPaneThereIsNothingToCopy)
{
    start();
    show(entries({}));
    clipboard = "before";
    type(U"y");
    EXPECT_EQ(clipboard, "before");
}

TEST_F(PaneViewTest, QuittingIsLeftToTheProgram)
{
    start();
    type(U"q");
    EXPECT_EQ(quits, 1);
}

TEST_F(PaneViewTest, NothingIsDrawnAgainWhileNothingChanges)
{
    start();
    show(entries({}));
    drawings = 0;
    loop.advance(60s);
    EXPECT_EQ(drawings, 0);
    EXPECT_EQ(loop.timers(), 0U);
}

TEST_F(PaneViewTest, NothingIsDrawnOnceTheWindowIsHidden)
{
    start();
    show(numbered(3));
    app->applicationWillTerminate();
    EXPECT_EQ(text(), "\n\n\n\n\n\n\n");
    press(Key::Enter);
    EXPECT_FALSE(screen.isAnimating());
}

} // namespace
} // namespace spectrel
