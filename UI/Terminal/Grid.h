#pragma once

#include "UI/Terminal/TerminalText.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

enum class Tint : std::uint8_t { Plain, Accent, Warning }; // colours, on terminals that have them

struct Style {
    bool isBold = false;
    bool isReversed = false;
    bool isFaint = false;
    Tint tint = Tint::Plain;
    friend bool operator==(const Style&, const Style&) = default;
};

/// One place on the screen.
struct GridCell {
    std::array<char32_t, 4> text {U' '}; // as in TerminalGlyph
    std::uint8_t columns = 1; // 0: covered by the wide glyph to its left
    Style style;
    friend bool operator==(const GridCell&, const GridCell&) = default;
};

/// The columns of one line that a text may use: from `left` to before `right`.
struct Span {
    int left = 0;
    int right = 0;
};

/// A screen in memory: cells of text with attributes. Whatever lies outside is cut off.
class Grid {
public:
    Grid() = default;
    Grid(int width, int height)
    {
        resize(width, height);
    }
    int width() const
    {
        return _width;
    }
    int height() const
    {
        return _height;
    }
    /// Empties the grid; negative lengths are none.
    void resize(int width, int height);
    void clear();
    /// `x` and `y` lie inside.
    const GridCell& at(int x, int y) const
    {
        return _cells[static_cast<std::size_t>(y) * static_cast<std::size_t>(_width) + static_cast<std::size_t>(x)];
    }

    /// Writes one line of text from column `x`, which may lie outside; a wide glyph that is cut shows as blanks.
    /// The column after the text.
    int put(int x, int y, std::string_view text, Style style, Span clip);
    int put(int x, int y, std::string_view text, Style style)
    {
        return put(x, y, text, style, {0, _width});
    }
    /// Blanks the columns.
    void fill(int y, Span span, Style style);
    /// Gives the columns of a line reversed colours, whatever is in them.
    void reverse(int y, Span span);

    /// The screen as lines of text without the blanks at their ends, each with a newline.
    std::string text() const;
    /// One letter a column: B bold, R reversed, M (marked twice) both, f faint, '.' plain; lines as in `text`.
    std::string styles() const;

private:
    GridCell& cell(int x, int y)
    {
        return const_cast<GridCell&>(at(x, y));
    }
    void set(int x, int y, const GridCell& content);

    int _width = 0;
    int _height = 0;
    std::vector<GridCell> _cells;
};

} // namespace spectrel
