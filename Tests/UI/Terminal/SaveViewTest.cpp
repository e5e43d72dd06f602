#include "Tests/UI/Terminal/TerminalFixture.h"

namespace spectrel {
namespace {

class SaveViewTest : public TerminalFixture {
protected:
    void open(int count)
    {
        startAllowingSave();
        auto contents = List::make();
        for (int entry = 0; entry < count; ++entry)
            contents->append(entries({{"Description", "Snapshot (" + std::to_string(entry) + ")"}}));
        model->saveContents = contents;
        show(numbered(3));
        type(U"s");
    }
};

TEST_F(SaveViewTest, ListsTheEntriesWithCheckMarksAndTheButtons)
{
    open(2);
    type(U"at the bridge");
    EXPECT_EQ(text(),
        " Save Snapshot\n"
        " Description: at the bridge\n"
        " ✓ Snapshot (0)\n"
        " ✓ Snapshot (1)\n"
        "\n"
        "\n"
        " [Save]  [Cancel]\n");
}

TEST_F(SaveViewTest, ReturnLeavesTheDescriptionAndReturnAgainSaves)
{
    open(1);
    type(U"qs?");
    press(Key::Enter);
    EXPECT_FALSE(app->saveViewController()->saveDescription()->isFirstResponder);
    EXPECT_TRUE(written.empty());
    press(Key::Enter);
    loop.runQueued();
    ASSERT_EQ(written.size(), 1U);
    EXPECT_EQ(*(*written[0].snapshot)["Description"].string(), "qs?");
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_EQ(line(0), " Spectrel                        ? help");
    EXPECT_EQ(quits, 0);
}

TEST_F(SaveViewTest, EscapeCancels)
{
    open(1);
    type(U"text");
    press(Key::Escape);
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(written.empty());
}

TEST_F(SaveViewTest, TheScreenOpensAfreshEachTime)
{
    open(1);
    press(Key::Tab, 3);
    press(Key::Enter); // Cancel
    loop.runQueued();
    ASSERT_EQ(app->saveViewController(), nullptr);
    type(U"s");
    type(U"x");
    EXPECT_EQ(line(1), " Description: x");
}

TEST_F(SaveViewTest, TypingEditsTheDescriptionAtItsEnd)
{
    open(1);
    type(U"ab日e\u0301");
    EXPECT_EQ(line(1), " Description: ab日e\u0301");
    press(Key::Backspace);
    EXPECT_EQ(line(1), " Description: ab日");
    press(Key::Backspace, 2);
    EXPECT_EQ(line(1), " Description: a");
    press(Key::ClearLine);
    EXPECT_EQ(line(1), " Description:");
    press(Key::Backspace);
    EXPECT_EQ(*app->saveViewController()->saveDescription()->text, "");
}

TEST_F(SaveViewTest, TheDescriptionIsEditedInTheMiddleToo)
{
    open(1);
    type(U"in car park");
    press(Key::Left, 8);
    type(U"the ");
    EXPECT_EQ(line(1), " Description: in the car park");
    press(Key::End);
    press(Key::EraseWord);
    EXPECT_EQ(*app->saveViewController()->saveDescription()->text, "in the car ");
    press(Key::Home);
    press(Key::Delete, 3);
    EXPECT_EQ(*app->saveViewController()->saveDescription()->text, "the car ");
    press(Key::Tab, 2);
    press(Key::Right); // to the other button, no longer in the text
    press(Key::Enter);
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_TRUE(written.empty());
}

TEST_F(SaveViewTest, TheEndOfALongDescriptionStaysInSight)
{
    open(1);
    type(U"0123456789012345678901234567890123456789END");
    EXPECT_EQ(line(1), " Description: 8901234567890123456789END");
}

TEST_F(SaveViewTest, ADescriptionDoesNotGrowWithoutBound)
{
    open(1);
    type(std::u32string(3000, U'日'));
    EXPECT_LE(app->saveViewController()->saveDescription()->text->size(), SaveView::MaximumDescription);
}

TEST_F(SaveViewTest, LettersOutsideTheDescriptionTypeNothing)
{
    open(1);
    press(Key::Tab);
    type(U"abc");
    EXPECT_EQ(line(1), " Description:");
    press(Key::BackTab);
    type(U"abc");
    EXPECT_EQ(line(1), " Description: abc");
}

TEST_F(SaveViewTest, AListLongerThanTheScreenScrolls)
{
    open(9);
    press(Key::Tab);
    EXPECT_EQ(line(2), " ✓ Snapshot (0)");
    press(Key::Down, 2);
    EXPECT_EQ(line(2), " ✓ Snapshot (2)");
    press(Key::PageDown, 5);
    EXPECT_EQ(line(5), " ✓ Snapshot (8)");
    wheel(MouseEvent::Action::WheelUp);
    EXPECT_EQ(line(5), " ✓ Snapshot (7)");
}

TEST_F(SaveViewTest, ClicksReachTheButtonsAndTheDescription)
{
    open(2);
    click(3, 2);
    EXPECT_FALSE(app->saveViewController()->saveDescription()->isFirstResponder);
    click(20, 1);
    EXPECT_TRUE(app->saveViewController()->saveDescription()->isFirstResponder);
    click(20, 5);
    EXPECT_FALSE(app->saveViewController()->saveDescription()->isFirstResponder);
    click(8, 6); // between the buttons
    loop.runQueued();
    ASSERT_NE(app->saveViewController(), nullptr);
    click(1, 6);
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
    EXPECT_EQ(written.size(), 1U);
}

TEST_F(SaveViewTest, AFailedSaveLeavesItsAlertOverThePanes)
{
    open(1);
    canWrite = false;
    press(Key::Enter, 2);
    loop.runQueued();
    EXPECT_EQ(app->saveViewController(), nullptr);
    screen.resize(40, 9);
    EXPECT_EQ(text(),
        " Spectrel                        ? help\n"
        " Row┌──────────────────────────────┐   0\n"
        " Row│ File Error                   │  10\n"
        " Row│                              │  20\n"
        "    │ Unable to write file to disk │\n"
        "    │                              │\n"
        "    │ [Close]                      │\n"
        "    └──────────────────────────────┘\n"
        " Updated 2024-03-05 at 14:07:31  [Save]\n");
}

TEST_F(SaveViewTest, AnyKeyClosesTheAlertAndDoesNothingElse)
{
    open(1);
    canWrite = false;
    press(Key::Enter, 2);
    loop.runQueued();
    type(U"q");
    EXPECT_EQ(quits, 0);
    EXPECT_EQ(line(1), " Row 0                                 0");
}

} // namespace
} // namespace spectrel
