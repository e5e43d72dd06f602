#pragma once

#include "Platform/Clock.h"
#include "Values/Bytes.h"

#include <cstdint>

namespace spectrel {

/// Writes one log record as a baseband frames it (`Records/Frame.h`), without a wrapper.
class RecordWriter {
public:
    /// A code from 0xFF0000 on belongs to the extra stream.
    RecordWriter(std::uint32_t code, Moment time);

    RecordWriter& u8(std::uint32_t value);
    RecordWriter& u16(std::uint32_t value);
    RecordWriter& u32(std::uint32_t value);
    RecordWriter& zeros(std::size_t count);
    RecordWriter& bytes(ByteView bytes);

    /// The finished record; its item length is set. Longer than 65535 bytes the length field keeps its low 16 bits.
    Bytes take();

private:
    Bytes _record;
};

/// The timestamp of a log item: 1/800 s since 1980-01-06 00:00 UTC in the upper 48 bits (3GPP2 C.S0002 system time).
std::uint64_t itemTimestamp(Moment time);

} // namespace spectrel
