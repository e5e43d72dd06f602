#pragma once

#include <array>
#include <cstddef>
#include <optional>
#include <string_view>

namespace spectrel {

/// What fills one place on the screen: a character and the marks that combine with it.
struct TerminalGlyph {
    std::array<char32_t, 4> text {}; // ends at the first 0; marks beyond the third are left out
    int columns = 1; // 1 or 2
    std::size_t bytes = 0; // that it took of the text, left-out ones included
};

/// Takes the first glyph off the text; none when nothing visible is left.
///
/// Whatever the bytes are, a glyph never holds anything that a terminal would obey: control characters show as their
/// pictures (U+2400 and up), what is no UTF-8, changes the direction of writing or has no width known shows as
/// U+FFFD, invisible format characters are left out, and a mark without a character stands on a blank.
std::optional<TerminalGlyph> takeGlyph(std::string_view& text);

/// The columns that the text takes on one line.
int columnsOf(std::string_view text);

} // namespace spectrel
