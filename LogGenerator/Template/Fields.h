#pragma once

#include "LogGenerator/Template/RecordView.h"
#include "Platform/TextBuffer.h"
#include "Platform/Value.h"

#include <cstdint>
#include <span>
#include <string_view>

namespace spectrel {

/// How a field stands in the record; multi-byte fields are little-endian.
enum class Width : std::uint8_t { U8, U16, U32 };

/// Makes a field's display text, in the buffer (handed over empty) or as a text that lives for ever.
using Formatter = std::string_view (*)(std::uint32_t value, TextBuffer& buffer);

/// One line of a section's record: where a field stands, the display key it is shown under, and how.
struct Field {
    std::uint16_t offset; // from the record's first byte
    Width width;
    std::string_view key;
    Formatter format;
};

/// "%d": a 32-bit field shows its bits as a signed number.
std::string_view decimal(std::uint32_t value, TextBuffer& buffer);

/// Writes the fields in table order into a section's dictionary; a node that is none loses them.
void storeFields(RecordView record, std::span<const Field> fields, const Value& sectionRef);

} // namespace spectrel
