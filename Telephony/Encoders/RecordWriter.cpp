#include "Telephony/Encoders/RecordWriter.h"

#include "Records/Frame.h"

#include <utility>

namespace spectrel {

std::uint64_t itemTimestamp(Moment time)
{
    constexpr Moment Origin = std::chrono::sys_days(std::chrono::year(1980) / 1 / 6);
    const auto microseconds = (time - Origin).count();
    return microseconds < 0 ? 0 : static_cast<std::uint64_t>(microseconds / 1250) << 16;
}

RecordWriter::RecordWriter(std::uint32_t code, Moment time)
{
    _record.reserve(64);
    const std::uint64_t timestamp = itemTimestamp(time);
    u8(code >= ExtraStream ? ExtraRecord : OrdinaryRecord);
    u16(0); // the item length, once it is known
    u16(code);
    u32(static_cast<std::uint32_t>(timestamp));
    u32(static_cast<std::uint32_t>(timestamp >> 32));
}

RecordWriter& RecordWriter::u8(std::uint32_t value)
{
    _record.push_back(static_cast<std::uint8_t>(value));
    return *this;
}

RecordWriter& RecordWriter::u16(std::uint32_t value)
{
    return u8(value).u8(value >> 8);
}

RecordWriter& RecordWriter::u32(std::uint32_t value)
{
    return u16(value).u16(value >> 16);
}

RecordWriter& RecordWriter::zeros(std::size_t count)
{
    _record.insert(_record.end(), count, 0);
    return *this;
}

RecordWriter& RecordWriter::bytes(ByteView bytes)
{
    _record.insert(_record.end(), bytes.begin(), bytes.end());
    return *this;
}

Bytes RecordWriter::take()
{
    const std::size_t itemLength = _record.size() - RecordTypeSize;
    _record[RecordTypeSize] = static_cast<std::uint8_t>(itemLength);
    _record[RecordTypeSize + 1] = static_cast<std::uint8_t>(itemLength >> 8);
    return std::move(_record);
}

} // namespace spectrel
