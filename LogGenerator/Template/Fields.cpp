#include "LogGenerator/Template/Fields.h"

namespace spectrel {

namespace {

/// The bytes that the field touches, as few as can be.
std::uint32_t bytesOf(RecordView record, Width width, std::size_t offset)
{
    const unsigned end = width.first + width.count;
    if (end <= 8)
        return record.u8(offset);
    return end <= 16 ? record.u16(offset) : record.u32(offset);
}

} // namespace

std::uint32_t fieldValue(RecordView record, const Field& field, std::size_t start)
{
    const auto [first, count, isSigned] = field.width;
    // Upwards until the last bit stands at the top, and back down: with copies of it, where it is a sign.
    const std::uint32_t atTop = bytesOf(record, field.width, start + field.offset) << (32 - first - count);
    return isSigned ? static_cast<std::uint32_t>(static_cast<std::int32_t>(atTop) >> (32 - count))
                    : atTop >> (32 - count);
}

std::string_view decimal(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.decimal(static_cast<std::int32_t>(value)).view();
}

void storeFields(RecordView record, std::span<const Field> fields, Dictionary& into, std::size_t start)
{
    TextBuffer buffer;
    for (const Field& field : fields) {
        buffer.clear();
        into.setText(field.key, field.format(fieldValue(record, field, start), buffer));
    }
}

DictionaryRef entryWithFields(RecordView record, std::span<const Field> fields, std::size_t start)
{
    auto entry = std::make_shared<Dictionary>();
    entry->reserve(fields.size());
    storeFields(record, fields, *entry, start);
    return entry;
}

std::string_view unsignedDecimal(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.decimal(value).view();
}

std::string_view decimalDB(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.decimal(static_cast<std::int32_t>(value)).text(" dB").view();
}

std::string_view decimalDBm(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.decimal(static_cast<std::int32_t>(value)).text(" dBm").view();
}

} // namespace spectrel
