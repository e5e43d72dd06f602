#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// Stands for what is no character.
constexpr char32_t ReplacementCharacter = 0xFFFD;

/// Whether Unicode has a place for it that text may hold: up to U+10FFFF, without the halves of UTF-16's pairs.
constexpr bool isCharacter(char32_t point)
{
    return point <= 0x10FFFF && (point < 0xD800 || point > 0xDFFF);
}

struct UTF8Character {
    char32_t character;
    std::size_t bytes; // 1 to 4, that it takes of the text
};

/// The character at the front; none where the text is empty or does not begin with a well-formed one (RFC 3629: the
/// shortest form, whole, and a character).
std::optional<UTF8Character> decodeUTF8(std::string_view text);

/// Appends one character, U+FFFD for what is none.
void appendUTF8(std::string& text, char32_t character);

} // namespace spectrel
