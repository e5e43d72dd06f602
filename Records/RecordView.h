#pragma once

#include "Values/Bytes.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

/// Bytes before the payload: type byte, 16-bit item length, 16-bit log code, 8-byte timestamp.
constexpr std::size_t RecordHeaderSize = 13;

/// One log record as the sections read it. Offsets count from its first byte, the header included; multi-byte fields
/// are little-endian and may be unaligned. Bytes past the end read as 0.
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
    /// What follows the header; empty for a record that ends before it.
    constexpr ByteView payload() const
    {
        return _bytes.size() > RecordHeaderSize ? _bytes.subspan(RecordHeaderSize) : ByteView();
    }

private:
    ByteView _bytes;
};

} // namespace spectrel
