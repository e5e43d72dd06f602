#pragma once

#include "Values/Bytes.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

/// A log record, or bytes that may hold some, as everything here reads them. Offsets count from the first byte, a
/// record's header included; multi-byte fields are little-endian and may be unaligned. Bytes past the end read as 0.
class RecordView {
public:
    constexpr RecordView(ByteView bytes)
        : _bytes(bytes)
    {
    }

    constexpr std::size_t size() const
    {
        return _bytes.size();
    }
    constexpr std::uint8_t u8(std::size_t offset) const
    {
        return offset < _bytes.size() ? _bytes[offset] : std::uint8_t(0);
    }
    constexpr std::uint16_t u16(std::size_t offset) const
    {
        return static_cast<std::uint16_t>(u8(offset) | u8(offset + 1) << 8);
    }
    constexpr std::int16_t s16(std::size_t offset) const
    {
        return static_cast<std::int16_t>(u16(offset));
    }
    constexpr std::uint32_t u32(std::size_t offset) const
    {
        return u16(offset) | static_cast<std::uint32_t>(u16(offset + 2)) << 16;
    }
    /// `count` bits (1 to 24), the first being bit `first` (0 to 7) of the byte at `offset`; a field that runs across
    /// bytes takes its low bits from the lower-addressed byte.
    constexpr std::uint32_t bits(std::size_t offset, unsigned first, unsigned count) const
    {
        return u32(offset) >> first & ((std::uint32_t(1) << count) - 1);
    }
    /// The bytes from there on; empty past the end.
    constexpr ByteView from(std::size_t offset) const
    {
        return offset < _bytes.size() ? _bytes.subspan(offset) : ByteView();
    }

private:
    ByteView _bytes;
};

} // namespace spectrel
