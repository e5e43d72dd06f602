#include "UI/Terminal/TerminalText.h"

#include "Values/UTF8.h"

#include <clocale>
#include <cwchar>
#include <locale.h>

namespace spectrel {

namespace {

constexpr char32_t ControlPictures = 0x2400;
constexpr char32_t DeletePicture = 0x2421;

/// The first character of a text that is not empty. A byte that does not begin a well-formed character stands for
/// itself alone, as the replacement.
UTF8Character firstCharacter(std::string_view text)
{
    return decodeUTF8(text).value_or(UTF8Character {ReplacementCharacter, 1});
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
        return ReplacementCharacter;
    return character;
}

/// Adds the marks that follow to the glyph and takes them off the text.
void takeMarks(std::string_view& text, TerminalGlyph& glyph, std::size_t marks)
{
    while (!text.empty()) {
        const UTF8Character next = firstCharacter(text);
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
        const UTF8Character first = firstCharacter(text);
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

} // namespace spectrel
