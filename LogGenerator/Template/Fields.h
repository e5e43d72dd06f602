#pragma once

#include "Records/RecordView.h"
#include "Values/Dictionary.h"
#include "Values/TextBuffer.h"
#include "Values/Value.h"

#include <cstddef>
#include <cstdint>
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

/// "%d": a 32-bit field shows its bits as a signed number.
std::string_view decimal(std::uint32_t value, TextBuffer& buffer);

/// A field's raw value; `start` is where the offsets count from.
std::uint32_t fieldValue(RecordView record, const Field& field, std::size_t start = 0);

/// Writes the fields in table order into a section's dictionary; a node that is none loses them.
void storeFields(RecordView record, std::span<const Field> fields, const Value& sectionRef, std::size_t start = 0);

/// A new dictionary with the fields in table order: one entry of a section's list, which stands at `start`.
DictionaryRef entryWithFields(RecordView record, std::span<const Field> fields, std::size_t start);

/// "%u".
std::string_view unsignedDecimal(std::uint32_t value, TextBuffer& buffer);
/// "%d dB".
std::string_view decimalDB(std::uint32_t value, TextBuffer& buffer);
/// "%d dBm".
std::string_view decimalDBm(std::uint32_t value, TextBuffer& buffer);

/// Shows a code's name in a table that is indexed by the code, and "Unknown" for a code past the table's end.
template <const auto& Names> std::string_view named(std::uint32_t code, TextBuffer&)
{
    return code < Names.size() ? Names[code] : std::string_view("Unknown");
}

/// Shows the first text of two for zero, the second for anything else.
template <const auto& Texts> std::string_view flagged(std::uint32_t value, TextBuffer&)
{
    static_assert(Texts.size() == 2);
    return Texts[value == 0 ? 0 : 1];
}

/// A record that is fields throughout: its log code, its least length in bytes (header included), its fields.
struct RecordLayout {
    std::uint32_t code;
    std::size_t minimumLength;
    std::span<const Field> fields;
};

/// Writes the fields of the layout with the record's log code; a record that is too short changes nothing. False when
/// no layout has the code.
bool storeRecord(
    RecordView record, std::uint32_t logCode, std::span<const RecordLayout> layouts, const Value& sectionRef);

} // namespace spectrel
