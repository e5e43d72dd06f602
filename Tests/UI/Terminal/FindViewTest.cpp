#include "Tests/UI/Terminal/TerminalFixture.h"

namespace spectrel {
namespace {

class FindViewTest : public TerminalFixture {
protected:
    void open()
    {
        start();
        show(display());
        type(U"/");
    }
    static DictionaryRef display()
    {
        return entries({{"Cell", entries({{"ID", "248"}, {"Band", "3"}})},
            {"List", List::make({entries({{"ID", "17"}}), entries({{"ID", "248"}})})}, {"State", "Idle"}});
    }
};

TEST_F(FindViewTest, RowsAreListedWhileTheTextIsTyped)
{
    open();
    EXPECT_EQ(text(),
        " Find:\n"
        "\n"
        "\n"
        "\n"
        "\n"
        "\n"
        "               Enter opens   Esc leaves\n");
    type(U"id");
    EXPECT_EQ(text(),
        " Find: id\n"
        " ID  /Cell                           248\n"
        " ID  /List/0                          17\n"
        " ID  /List/1                         248\n"
        " State  /                           Idle\n"
        "\n"
        " 4 found       Enter opens   Esc leaves\n");
    EXPECT_EQ(cursorLine(), 1);
}

TEST_F(FindViewTest, ReturnOpensThePaneWithTheCursorOnTheRow)
{
    open();
    type(U"248");
    press(Key::Down);
    press(Key::Enter);
    EXPECT_EQ(openPaths(), "/ /List /List/1 ");
    EXPECT_EQ(line(1), " ID                                  248");
    press(Key::Backspace, 2);
    type(U"/");
    type(U"state");
    press(Key::Enter);
    EXPECT_EQ(cursorLine(), 3) << "the cursor is on the row found, not where it was";
}

TEST_F(FindViewTest, NAndCapitalNGoOnToTheOtherFinds)
{
    open();
    type(U"248");
    press(Key::Enter);
    EXPECT_EQ(openPaths(), "/ /Cell ");
    type(U"n");
    EXPECT_EQ(openPaths(), "/ /List /List/1 ");
    type(U"N");
    EXPECT_EQ(openPaths(), "/ /Cell ");
}

TEST_F(FindViewTest, EscapeLeavesEverythingAsItWas)
{
    open();
    type(U"248");
    press(Key::Escape);
    EXPECT_EQ(openPaths(), "/ ");
    EXPECT_EQ(cursorLine(), 1);
}

TEST_F(FindViewTest, KeysOfThePanesAreLettersHere)
{
    open();
    type(U"qsyn?");
    EXPECT_EQ(line(0), " Find: qsyn?");
    EXPECT_EQ(quits, 0);
    EXPECT_EQ(line(6), " nothing found") << "the count comes before the keys";
    press(Key::Enter);
    EXPECT_EQ(line(0), " Find: qsyn?") << "there is nothing to open";
}

TEST_F(FindViewTest, TheTextIsEditedInTheMiddle)
{
    open();
    type(U"8");
    press(Key::Home);
    type(U"24");
    EXPECT_EQ(line(6), " 2 found       Enter opens   Esc leaves");
    press(Key::ClearLine);
    EXPECT_EQ(line(0), " Find:");
}

TEST_F(FindViewTest, ALongListScrollsWithItsSelection)
{
    start();
    show(numbered(30));
    type(U"/");
    type(U"row");
    press(Key::PageDown, 2);
    EXPECT_EQ(line(5), " Row 10  /                           100");
    EXPECT_EQ(cursorLine(), 5);
    wheel(MouseEvent::Action::WheelDown);
    EXPECT_EQ(line(5), " Row 11  /                           110");
    press(Key::PageUp, 9);
    EXPECT_EQ(cursorLine(), 1);
}

TEST_F(FindViewTest, APressOpensTheRowUnderIt)
{
    open();
    type(U"id");
    click(3, 3);
    EXPECT_EQ(openPaths(), "/ /List /List/1 ");
}

TEST_F(FindViewTest, TheListFollowsAReload)
{
    open();
    type(U"id");
    show(entries({{"ID", "5"}}));
    EXPECT_EQ(line(1), " ID  /                                 5");
    EXPECT_EQ(line(6), " 1 found       Enter opens   Esc leaves");
}

TEST_F(FindViewTest, NoWindowIsTooSmall)
{
    open();
    type(U"id");
    for (int width = 0; width <= 12; ++width) {
        for (int height = 0; height <= 4; ++height) {
            screen.resize(width, height);
            screen.draw();
            click(0, 1);
            type(U"/");
            type(U"id");
        }
    }
    EXPECT_FALSE(screen.isAnimating());
}

} // namespace
} // namespace spectrel
