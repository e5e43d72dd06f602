#include "Values/UTF8.h"

namespace spectrel {

namespace {

struct Form {
    unsigned char lead; // of the first byte: its fixed upper bits
    char32_t least; // shorter forms tell what is below
};

/// By the number of bytes, from two on.
constexpr Form Forms[] = {{0xC0, 0x80}, {0xE0, 0x800}, {0xF0, 0x10000}};

} // namespace

std::optional<UTF8Character> decodeUTF8(std::string_view text)
{
    const auto byte = [text](std::size_t at) { return static_cast<unsigned char>(text[at]); };
    if (text.empty())
        return std::nullopt;
    const unsigned lead = byte(0);
    if (lead < 0x80)
        return UTF8Character {lead, 1};
    const std::size_t length = lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : 2;
    if (lead < 0xC2 || lead > 0xF4 || text.size() < length)
        return std::nullopt;
    char32_t character = lead & (0x7FU >> length);
    for (std::size_t at = 1; at < length; ++at) {
        if ((byte(at) & 0xC0U) != 0x80)
            return std::nullopt;
        character = character << 6 | (byte(at) & 0x3FU);
    }
    if (character < Forms[length - 2].least || !isCharacter(character))
        return std::nullopt;
    return UTF8Character {character, length};
}

void appendUTF8(std::string& text, char32_t character)
{
    if (!isCharacter(character))
        character = ReplacementCharacter;
    if (character < 0x80) {
        text += static_cast<char>(character);
        return;
    }
    const std::size_t length = character < 0x800 ? 2 : character < 0x10000 ? 3 : 4;
    const auto append = [&text](char32_t byte) { text += static_cast<char>(static_cast<unsigned char>(byte)); };
    append(Forms[length - 2].lead | character >> 6 * (length - 1));
    for (std::size_t left = length - 1; left > 0; --left)
        append(0x80 | (character >> 6 * (left - 1) & 0x3F));
}

} // namespace spectrel
