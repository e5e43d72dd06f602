#include "UI/Terminal/LineEditor.h"

#include "Values/UTF8.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

class LineEditorTest : public testing::Test {
protected:
    void type(std::u32string_view characters)
    {
        for (const char32_t character : characters)
            EXPECT_TRUE(editor.handle({Key::Character, character}, text, maximum));
    }
    void press(Key key, int times = 1)
    {
        for (; times > 0; --times)
            EXPECT_TRUE(editor.handle({key}, text, maximum));
    }
    /// What is shown in eight columns, the cursor in brackets.
    std::string shown() const
    {
        Grid grid(8, 1);
        editor.draw(grid, 0, {0, 8}, text, true);
        std::string line;
        for (int x = 0; x < grid.width(); ++x) {
            std::string cell;
            for (const char32_t character : grid.at(x, 0).text) {
                if (character != 0)
                    appendUTF8(cell, character);
            }
            line += grid.at(x, 0).style.isReversed && !cell.empty() ? "[" + cell + "]" : cell;
        }
        return line;
    }

    LineEditor editor;
    std::string text;
    std::size_t maximum = 100;
};

TEST_F(LineEditorTest, TypingInsertsAtTheCursor)
{
    type(U"ad");
    press(Key::Left);
    type(U"bc");
    EXPECT_EQ(text, "abcd");
    EXPECT_EQ(shown(), "abc[d]    ");
}

TEST_F(LineEditorTest, TheCursorStopsAtBothEnds)
{
    type(U"ab");
    press(Key::Right, 3);
    EXPECT_EQ(shown(), "ab[ ]     ");
    press(Key::Left, 5);
    EXPECT_EQ(shown(), "[a]b      ");
    press(Key::Backspace);
    press(Key::End);
    press(Key::Delete);
    EXPECT_EQ(text, "ab");
}

TEST_F(LineEditorTest, WideAndCombinedGlyphsAreOneStep)
{
    type(U"a日e\u0301b");
    press(Key::Left, 2);
    press(Key::Backspace);
    EXPECT_EQ(text, "ae\u0301b");
    press(Key::Delete);
    EXPECT_EQ(text, "ab");
}

TEST_F(LineEditorTest, AMarkJoinsTheLetterBeforeTheCursor)
{
    type(U"eb");
    press(Key::Left);
    type(U"\u0301");
    press(Key::Backspace);
    EXPECT_EQ(text, "b");
}

TEST_F(LineEditorTest, WordsAreErasedWithTheBlanksBehindThem)
{
    type(U"one two  ");
    press(Key::EraseWord);
    EXPECT_EQ(text, "one ");
    press(Key::EraseWord, 2);
    EXPECT_EQ(text, "");
    type(U"one two");
    press(Key::Left, 2);
    press(Key::EraseWord);
    EXPECT_EQ(text, "one wo");
    press(Key::ClearLine);
    EXPECT_EQ(text, "");
}

TEST_F(LineEditorTest, TheCursorStaysInSightInALongText)
{
    type(U"0123456789");
    EXPECT_EQ(shown(), "3456789[ ]");
    press(Key::Left, 5);
    EXPECT_EQ(shown(), "01234[5]67");
    press(Key::Home);
    EXPECT_EQ(shown(), "[0]1234567");
}

TEST_F(LineEditorTest, ATextIsNeverLongerThanItsMaximum)
{
    maximum = 4;
    type(U"abc日d");
    EXPECT_EQ(text, "abcd");
}

TEST_F(LineEditorTest, BytesThatAreNoCharactersCanBeErased)
{
    text = "a\xFF\xE6\x97"
           "b";
    press(Key::Left);
    press(Key::Backspace, 3);
    EXPECT_EQ(text, "ab");
}

TEST_F(LineEditorTest, ATextThatOthersShortenedTakesTheCursorAlong)
{
    type(U"abcdef");
    press(Key::Left);
    text = "日";
    press(Key::Backspace);
    EXPECT_EQ(text, "");
    EXPECT_FALSE(editor.handle({Key::Up}, text, maximum));
}

} // namespace
} // namespace spectrel
