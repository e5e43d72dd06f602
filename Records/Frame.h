#pragma once

#include "Records/RecordView.h"
#include "Values/Bytes.h"

#include <cstdint>

namespace spectrel {

/// A record's type byte.
constexpr std::uint8_t OrdinaryRecord = 0x01;
constexpr std::uint8_t ExtraRecord = 0xFF;

/// Added to the 16-bit code of a record of the extra stream (type byte 0xFF).
constexpr std::uint32_t ExtraStream = 0xFF0000;

/// A message's record: without the 2-byte wrapper that a first byte of 0x81 announces. The message has at least 2
/// bytes.
constexpr ByteView recordInMessage(ByteView message)
{
    constexpr std::uint8_t WrapperMark = 0x81;
    constexpr std::size_t WrapperSize = 2;
    return message[0] == WrapperMark ? message.subspan(WrapperSize) : message;
}

/// The code by which a record is routed.
constexpr std::uint32_t routingCode(RecordView record)
{
    return record.u16(3) | (record.u8(0) == ExtraRecord ? ExtraStream : 0);
}

/// For a type byte that is neither of the two; not every generator drops the record as the line says.
inline constexpr const char* InvalidTypeLine = "Invalid log type: %x. Dropping.";

} // namespace spectrel
