#include "UI/Terminal/Grid.h"

#include "Values/UTF8.h"

#include <algorithm>

namespace spectrel {

void Grid::resize(int width, int height)
{
    _width = std::max(0, width);
    _height = std::max(0, height);
    clear();
}

void Grid::clear()
{
    _cells.assign(static_cast<std::size_t>(_width) * static_cast<std::size_t>(_height), GridCell());
}

/// Sets one cell; a wide glyph that loses its other half there becomes blank.
void Grid::set(int x, int y, const GridCell& content)
{
    if (at(x, y).columns == 0 && x > 0 && at(x - 1, y).columns == 2)
        cell(x - 1, y) = GridCell {.style = at(x - 1, y).style};
    if (at(x, y).columns == 2 && x + 1 < _width)
        cell(x + 1, y) = GridCell {.style = at(x + 1, y).style};
    cell(x, y) = content;
}

int Grid::put(int x, int y, std::string_view text, Style style, Span clip)
{
    const int left = std::max(clip.left, 0);
    const int right = std::min(clip.right, _width);
    while (const auto glyph = takeGlyph(text)) {
        const int end = x + glyph->columns;
        if (y < 0 || y >= _height || x >= right)
            return end;
        if (x >= left && end <= right) {
            if (glyph->columns == 2)
                set(x + 1, y, {{}, 0, style});
            set(x, y, {glyph->text, 1, style});
            cell(x, y).columns = static_cast<std::uint8_t>(glyph->columns);
        } else {
            fill(y, {std::max(x, left), std::min(end, right)}, style);
        }
        x = end;
    }
    return x;
}

void Grid::fill(int y, Span span, Style style)
{
    if (y < 0 || y >= _height)
        return;
    for (int x = std::max(0, span.left); x < std::min(span.right, _width); ++x)
        set(x, y, {.style = style});
}

void Grid::reverse(int y, Span span)
{
    if (y < 0 || y >= _height)
        return;
    for (int x = std::max(0, span.left); x < std::min(span.right, _width); ++x)
        cell(x, y).style.isReversed = true;
}

namespace {

void appendTrimmed(std::string& lines, std::string line)
{
    line.erase(line.find_last_not_of(' ') + 1);
    lines += line + "\n";
}

} // namespace

std::string Grid::text() const
{
    std::string lines;
    for (int y = 0; y < _height; ++y) {
        std::string line;
        for (int x = 0; x < _width; ++x) {
            for (const char32_t character : at(x, y).text) {
                if (character != 0)
                    appendUTF8(line, character);
            }
        }
        appendTrimmed(lines, std::move(line));
    }
    return lines;
}

std::string Grid::styles() const
{
    std::string lines;
    for (int y = 0; y < _height; ++y) {
        std::string line;
        for (int x = 0; x < _width; ++x) {
            const Style& style = at(x, y).style;
            line += style.isBold && style.isReversed ? 'M'
                : style.isBold                       ? 'B'
                : style.isReversed                   ? 'R'
                : style.isFaint                      ? 'f'
                                                     : '.';
        }
        lines += line + "\n";
    }
    return lines;
}

} // namespace spectrel
