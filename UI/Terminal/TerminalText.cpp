#include "UI/Terminal/TerminalText.h"

#include <clocale>
#include <cwchar>
#include <locale.h>

namespace spectrel {

namespace {

constexpr char32_t Replacement = 0xFFFD;
constexpr char32_t ControlPictures = 0x2400;
constexpr char32_t DeletePicture = 0x2421;

struct Decoded {
    char32_t character = Replacement;
    std::size_t bytes = 1;
};

/// The first character of a text that is not empty. Strict: a byte that does not begin a well-formed character stands
/// for itself alone, as the replacement.
Decoded decodeUTF8(std::string_view text)
{
    const auto byte = [text](std::size_t at) { return static_cast<unsigned char>(text[at]); };
    const unsigned lead = byte(0);
    if (lead < 0x80)
        return {lead, 1};
    const std::size_t length = lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : 2;
    if (lead < 0xC2 || lead > 0xF4 || text.size() < length)
        return {};
    char32_t character = lead & (0x7FU >> length);
    for (std::size_t at = 1; at < length; ++at) {
        if ((byte(at) & 0xC0U) != 0x80)
            return {};
        character = (character << 6) | (byte(at) & 0x3FU);
    }
    const char32_t least = length == 4 ? 0x10000 : length == 3 ? 0x800 : 0x80;
    if (character < least || character > 0x10FFFF || (character >= 0xD800 && character <= 0xDFFF))
        return {};
    return {character, length};
}

/// The width by the tables of a UTF-8 locale, whichever locale the program runs in; -1 when it is not known.
int widthOf(char32_t character)
{
    if (character >= 0x20 && character < 0x7F)
        return 1;
    static const locale_t utf8 = ::newlocale(LC_CTYPE_MASK, "C.UTF-8", nullptr);
    if (!utf8)
        return character < 0x300 ? 1 : -1;
    const locale_t before = ::uselocale(utf8);
    const int width = ::wcwidth(static_cast<wchar_t>(character));
    ::uselocale(before);
    return width;
}

bool isDirectionControl(char32_t character)
{
    return character == 0x061C || (character >= 0x202A && character <= 0x202E)
        || (character >= 0x2066 && character <= 0x2069);
}

bool isInvisible(char32_t character)
{
    return character == 0x00AD || (character >= 0x200B && character <= 0x200F)
        || (character >= 0x2060 && character <= 0x2064) || (character >= 0xFE00 && character <= 0xFE0F)
        || character == 0xFEFF || (character >= 0xE0000 && character <= 0xE01EF);
}

/// The character as it may be shown.
char32_t shown(char32_t character)
{
    if (character < 0x20)
        return ControlPictures + character;
    if (character == 0x7F)
        return DeletePicture;
    if (isDirectionControl(character) || widthOf(character) < 0)
        return Replacement;
    return character;
}

/// Adds the marks that follow to the glyph and takes them off the text.
void takeMarks(std::string_view& text, TerminalGlyph& glyph, std::size_t marks)
{
    while (!text.empty()) {
        const Decoded next = decodeUTF8(text);
        const bool skips = isInvisible(next.character);
        if (!skips && (widthOf(next.character) != 0 || shown(next.character) != next.character))
            return;
        if (!skips && marks < glyph.text.size())
            glyph.text[marks++] = next.character;
        glyph.bytes += next.bytes;
        text.remove_prefix(next.bytes);
    }
}

} // namespace

std::optional<TerminalGlyph> takeGlyph(std::string_view& text)
{
    TerminalGlyph glyph;
    while (!text.empty()) {
        const Decoded first = decodeUTF8(text);
        if (isInvisible(first.character)) {
            glyph.bytes += first.bytes;
            text.remove_prefix(first.bytes);
            continue;
        }
        const char32_t character = shown(first.character);
        const int width = widthOf(character);
        if (width == 0) {
            glyph.text[0] = U' ';
        } else {
            glyph.text[0] = character;
            glyph.columns = width > 1 ? 2 : 1;
            glyph.bytes += first.bytes;
            text.remove_prefix(first.bytes);
        }
        takeMarks(text, glyph, 1);
        return glyph;
    }
    return std::nullopt;
}

int columnsOf(std::string_view text)
{
    int columns = 0;
    while (const auto glyph = takeGlyph(text))
        columns += glyph->columns;
    return columns;
}

void appendUTF8(std::string& text, char32_t character)
{
    if (character > 0x10FFFF || (character >= 0xD800 && character <= 0xDFFF))
        character = Replacement;
    const auto append = [&text](char32_t byte) { text += static_cast<char>(static_cast<unsigned char>(byte)); };
    if (character < 0x80) {
        append(character);
        return;
    }
    if (character < 0x800) {
        append(0xC0 | (character >> 6));
    } else if (character < 0x10000) {
        append(0xE0 | (character >> 12));
        append(0x80 | ((character >> 6) & 0x3F));
    } else {
        append(0xF0 | (character >> 18));
        append(0x80 | ((character >> 12) & 0x3F));
        append(0x80 | ((character >> 6) & 0x3F));
    }
    append(0x80 | (character & 0x3F));
}

} // namespace spectrel
