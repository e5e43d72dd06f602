#include "UI/Terminal/Grid.h"

#include "Values/UTF8.h"

#include <gtest/gtest.h>

namespace spectrel {
namespace {

TEST(GridTest, TextIsCutAtBothEdges)
{
    Grid grid(4, 1);
    EXPECT_EQ(grid.put(-2, 0, "abcdefgh", {}), 5);
    EXPECT_EQ(grid.text(), "cdef\n");
    grid.put(0, 3, "outside", {});
    grid.put(0, -1, "outside", {});
    EXPECT_EQ(grid.text(), "cdef\n");
}

TEST(GridTest, AWideGlyphCutInTwoShowsAsABlank)
{
    Grid grid(3, 1);
    grid.put(0, 0, "a日日", {});
    EXPECT_EQ(grid.text(), "a日\n");
    grid.put(-1, 0, "日bc", {});
    EXPECT_EQ(grid.text(), " bc\n");
}

TEST(GridTest, WritingOverHalfOfAWideGlyphBlanksTheOtherHalf)
{
    Grid grid(4, 1);
    grid.put(0, 0, "日日", {});
    grid.put(1, 0, "x", {});
    EXPECT_EQ(grid.text(), " x日\n");
    grid.put(2, 0, "y", {});
    EXPECT_EQ(grid.text(), " xy\n");
    grid.put(0, 0, "abcd", {});
    grid.put(1, 0, "日", {});
    EXPECT_EQ(grid.text(), "a日d\n");
    grid.put(0, 0, "日", {});
    EXPECT_EQ(grid.text(), "日 d\n");
}

TEST(TerminalTextTest, ColumnsAreThoseOfTheTerminal)
{
    EXPECT_EQ(columnsOf(""), 0);
    EXPECT_EQ(columnsOf("abc"), 3);
    EXPECT_EQ(columnsOf("日本"), 4);
    EXPECT_EQ(columnsOf("e\u0301"), 1);
    EXPECT_EQ(columnsOf("\u0301"), 1); // a mark without a letter stands on a blank
    EXPECT_EQ(columnsOf("a\u200Bb"), 2);
    EXPECT_EQ(columnsOf("\xF0\x9F\x93"), 3); // a truncated character: each byte for itself
    EXPECT_EQ(columnsOf(std::string_view("\0", 1)), 1);
}

TEST(TerminalTextTest, OverlongAndSurrogateFormsAreNoCharacters)
{
    std::string_view overlong = "\xC0\xAF";
    EXPECT_EQ(takeGlyph(overlong)->text[0], U'\uFFFD');
    std::string_view surrogate = "\xED\xA0\x80";
    EXPECT_EQ(takeGlyph(surrogate)->text[0], U'\uFFFD');
    EXPECT_EQ(surrogate.size(), 2U);
    std::string_view beyond = "\xF4\x90\x80\x80";
    EXPECT_EQ(takeGlyph(beyond)->text[0], U'\uFFFD');
}

TEST(TerminalTextTest, MarksBeyondTheThirdAreLeftOut)
{
    std::string_view text = "a\u0301\u0302\u0303\u0304\u0305z";
    const auto glyph = takeGlyph(text);
    EXPECT_EQ(glyph->text, (std::array<char32_t, 4> {U'a', 0x301, 0x302, 0x303}));
    EXPECT_EQ(text, "z");
}

TEST(TerminalTextTest, CharactersBecomeUTF8)
{
    std::string text;
    for (const char32_t character : {U'a', U'é', U'日', char32_t(0x1F600), char32_t(0xD800), char32_t(0x110000)})
        appendUTF8(text, character);
    EXPECT_EQ(text, "aé日\xF0\x9F\x98\x80\uFFFD\uFFFD");
}

} // namespace
} // namespace spectrel
