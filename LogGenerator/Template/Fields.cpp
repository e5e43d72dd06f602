#include "LogGenerator/Template/Fields.h"

#include "Platform/Dictionary.h"

namespace spectrel {

namespace {

std::uint32_t read(RecordView record, const Field& field)
{
    switch (field.width) {
    case Width::U8:
        return record.u8(field.offset);
    case Width::U16:
        return record.u16(field.offset);
    case Width::U32:
        return record.u32(field.offset);
    }
    return 0;
}

} // namespace

std::string_view decimal(std::uint32_t value, TextBuffer& buffer)
{
    return buffer.decimal(static_cast<std::int32_t>(value)).view();
}

void storeFields(RecordView record, std::span<const Field> fields, const Value& sectionRef)
{
    Dictionary* section = sectionRef.dictionary().get();
    if (!section)
        return;
    TextBuffer buffer;
    for (const Field& field : fields) {
        buffer.clear();
        section->setText(field.key, field.format(read(record, field), buffer));
    }
}

} // namespace spectrel
