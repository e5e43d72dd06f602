#pragma once

#include "Records/RecordView.h"
#include "Values/Dictionary.h"
#include "Values/TextBuffer.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <span>
#include <string_view>

namespace spectrel {

/// Which bits of the record, counted from a field's offset on, are the field: `count` of them (1 to 32), the first
/// being bit `first` of the byte at the offset; `first` + `count` is 32 at most. Little-endian: a field that runs
/// across bytes takes its low bits from the lower-addressed byte. A signed one is in two's complement.
struct Width {
    std::uint8_t first;
    std::uint8_t count;
    bool isSigned = false;

    static const Width U8, S8, U16, S16, U32;
};
inline constexpr Width Width::U8 {0, 8};
inline constexpr Width Width::S8 {0, 8, true};
inline constexpr Width Width::U16 {0, 16};
inline constexpr Width Width::S16 {0, 16, true};
inline constexpr Width Width::U32 {0, 32};

/// A bit field; bit 0 is the least significant of the byte at the offset.
constexpr Width bits(std::uint8_t first, std::uint8_t count)
{
    return {first, count};
}

/// Makes a field's display text, in the buffer (handed over empty) or as a text that lives for ever. A signed field
/// comes extended to 32 bits.
using Formatter = std::string_view (*)(std::uint32_t value, TextBuffer& buffer);

/// One line of a section's record: where a field stands, the display key it is shown under, and how.
struct Field {
    std::uint16_t offset; // from the record's first byte, or from an entry's
    Width width;
    std::string_view key;
    Formatter format;
};

/// Tables one behind the other, as one.
template <std::size_t... Counts> constexpr auto joined(const std::array<Field, Counts>&... tables)
{
    std::array<Field, (Counts + ...)> all {};
    auto end = all.begin();
    ((end = std::ranges::copy(tables, end).out), ...);
    return all;
}

/// "%d": a 32-bit field shows its bits as a signed number.
std::string_view decimal(std::uint32_t value, TextBuffer& buffer);

/// A field's raw value; `start` is where the offsets count from.
std::uint32_t fieldValue(RecordView record, const Field& field, std::size_t start = 0);

/// Writes the fields in table order into a dictionary.
void storeFields(RecordView record, std::span<const Field> fields, Dictionary& into, std::size_t start = 0);

/// A new dictionary with the fields in table order: one entry of a section's list, which stands at `start`.
DictionaryRef entryWithFields(RecordView record, std::span<const Field> fields, std::size_t start);

/// "%u".
std::string_view unsignedDecimal(std::uint32_t value, TextBuffer& buffer);
/// "%d dB".
std::string_view decimalDB(std::uint32_t value, TextBuffer& buffer);
/// "%d dBm".
std::string_view decimalDBm(std::uint32_t value, TextBuffer& buffer);

/// Texts of codes that are not all the numbers from 0 on: ascending, and what any other code shows.
struct CodeText {
    std::uint32_t code;
    std::string_view text;
};
template <std::size_t Count> struct CodeTexts {
    CodeText texts[Count];
    std::string_view anyOther = "Unknown";
};

template <std::size_t Count> constexpr bool isAscending(const CodeTexts<Count>& table)
{
    return std::ranges::is_sorted(table.texts, std::ranges::less_equal(), &CodeText::code);
}
template <std::size_t Count> constexpr std::string_view textOf(const CodeTexts<Count>& table, std::uint32_t code)
{
    const auto text = std::ranges::lower_bound(table.texts, code, {}, &CodeText::code);
    return text != std::ranges::end(table.texts) && text->code == code ? text->text : table.anyOther;
}

/// Shows a code's name in a table of texts that is indexed by the code, "Unknown" past its end; or in a `CodeTexts`.
template <const auto& Names> std::string_view named(std::uint32_t code, TextBuffer&)
{
    if constexpr (requires { Names.anyOther; }) {
        static_assert(isAscending(Names));
        return textOf(Names, code);
    } else {
        return code < Names.size() ? Names[code] : std::string_view("Unknown");
    }
}

/// Shows the first text of two for zero, the second for anything else.
template <const auto& Texts> std::string_view flagged(std::uint32_t value, TextBuffer&)
{
    static_assert(Texts.size() == 2);
    return Texts[value == 0 ? 0 : 1];
}

} // namespace spectrel
