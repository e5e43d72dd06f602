#pragma once

#include "Values/Bytes.h"
#include "Values/Value.h"

#include <cstdint>
#include <initializer_list>

namespace spectrel {

/// Builds one log message for a test, byte by byte: offsets count from the record's first byte.
class RecordBuilder {
public:
    /// A record of `size` bytes, zero but for its header. A code from 0xFF0000 on makes a record of the extra stream.
    RecordBuilder(std::uint32_t code, std::size_t size);
    /// A record of the extra stream whose payload is the property list.
    static RecordBuilder withPropertyList(std::uint32_t code, const Value& payload);
    /// A record with exactly this payload.
    static RecordBuilder withPayload(std::uint32_t code, ByteView payload);

    RecordBuilder& u8(std::size_t offset, std::uint32_t value);
    RecordBuilder& u16(std::size_t offset, std::uint32_t value);
    RecordBuilder& u32(std::size_t offset, std::uint32_t value);
    /// Cuts the record to its first bytes.
    RecordBuilder& shrink(std::size_t size);
    /// Puts the 2-byte wrapper before the record.
    RecordBuilder& wrap();

    operator ByteView() const
    {
        return _bytes;
    }
    const Bytes& bytes() const
    {
        return _bytes;
    }

private:
    Bytes _bytes;
};

} // namespace spectrel
