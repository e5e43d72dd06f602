#include "UI/Terminal/Box.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr int SmallestFramed = 5; // lines of the screen
constexpr std::string_view MoreAbove = " more above ";
constexpr std::string_view MoreBelow = " more below ";

constexpr int Frame = 4; // columns beside the text

/// Where the line's last column begins; 0 where it has but one.
std::size_t lastColumn(const std::string& line)
{
    const auto gap = line.rfind("  ");
    return gap == std::string::npos ? 0 : gap + 2;
}

std::string bar(int columns)
{
    std::string text;
    for (int column = 0; column < columns; ++column)
        text += "─";
    return text;
}

void drawEdge(Grid& grid, int y, Span span, std::string_view left, std::string_view right, std::string_view hint)
{
    const int inner = span.right - span.left - 2;
    grid.put(span.left, y, std::string(left) + bar(inner) + std::string(right), Style {});
    grid.put(span.left + 2, y, hint, Style {}, {span.left, span.right - 1});
}

} // namespace

std::size_t boxRoom(int height)
{
    return static_cast<std::size_t>(std::max(1, height < SmallestFramed ? height : height - 2));
}

std::vector<std::string> brokenForBox(const std::vector<std::string>& lines, int width)
{
    const auto room = static_cast<std::size_t>(std::max(1, width - Frame));
    std::vector<std::string> broken;
    for (std::string rest : lines) {
        const std::size_t column = lastColumn(rest);
        const std::string indent(3 * column <= 2 * room ? column : 2, ' ');
        for (std::size_t start = 0; rest.size() > room; start = indent.size()) {
            const auto end = rest.rfind(' ', room);
            const auto next = rest.find_first_not_of(' ', end);
            if (end == std::string::npos || end <= start || next == std::string::npos)
                break; // a word alone is too long, and is cut
            broken.push_back(rest.substr(0, rest.find_last_not_of(' ', end) + 1));
            rest = indent + rest.substr(next);
        }
        broken.push_back(std::move(rest));
    }
    return broken;
}

void drawBox(Grid& grid, const std::vector<std::string>& lines, std::size_t top)
{
    int inner = 0;
    for (const std::string& line : lines)
        inner = std::max(inner, columnsOf(line));
    const int width = std::min(inner + Frame, grid.width());
    const int left = (grid.width() - width) / 2;
    const Span span {left, left + width};
    const bool isFramed = grid.height() >= SmallestFramed;
    const std::size_t shown = std::min(lines.size() - std::min(top, lines.size()), boxRoom(grid.height()));
    const int height = static_cast<int>(shown) + (isFramed ? 2 : 0);
    const int firstLine = std::max(0, (grid.height() - height) / 2);
    int y = firstLine;
    if (isFramed)
        drawEdge(grid, y++, span, "┌", "┐", top > 0 ? MoreAbove : std::string_view());
    for (std::size_t index = top; index < top + shown; ++index, ++y) {
        grid.fill(y, span, Style {});
        if (isFramed) {
            grid.put(span.left, y, "│", Style {});
            grid.put(span.right - 1, y, "│", Style {});
        }
        grid.put(span.left + 2, y, lines[index], Style {.isBold = index == 0}, {span.left, span.right - 1});
    }
    if (isFramed)
        drawEdge(grid, y, span, "└", "┘", top + shown < lines.size() ? MoreBelow : std::string_view());
}

} // namespace spectrel
