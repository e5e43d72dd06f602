#pragma once

#include "Records/RecordView.h"
#include "Values/Bytes.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <optional>

/// How a log record travels, the only place that knows it; numbers are little-endian:
///
///     [0x81, one byte]  type byte  length (16 bits)  log code (16 bits)  timestamp (64 bits)  payload
///
/// All of it is a message, the brackets being a wrapper that some messages have. Without the wrapper it is a record,
/// and from the length on an item, as a DLF holds it. The length counts the item's bytes, its own two included.
namespace spectrel {

constexpr std::uint8_t WrapperMark = 0x81;
constexpr std::size_t WrapperSize = 2;

/// A record's type byte.
constexpr std::uint8_t OrdinaryRecord = 0x01;
constexpr std::uint8_t ExtraRecord = 0xFF;
constexpr std::size_t RecordTypeSize = 1;

constexpr std::size_t ItemLengthSize = 2;
constexpr std::size_t ItemCodeSize = 2;
constexpr std::size_t ItemTimestampSize = 8;
/// Bytes before the payload, and so the least length of an item and of a record.
constexpr std::size_t ItemHeaderSize = ItemLengthSize + ItemCodeSize + ItemTimestampSize;
constexpr std::size_t RecordHeaderSize = RecordTypeSize + ItemHeaderSize;

/// Added to the 16-bit code of a record of the extra stream (type byte 0xFF).
constexpr std::uint32_t ExtraStream = 0xFF0000;

constexpr bool isRecordType(std::uint8_t byte)
{
    return byte == OrdinaryRecord || byte == ExtraRecord;
}

/// Where the record of a message stands that starts at `message`.
constexpr std::size_t recordPlace(RecordView bytes, std::size_t message)
{
    return message + (bytes.u8(message) == WrapperMark ? WrapperSize : 0);
}

/// A message's record, to the end of the message; empty for a message that ends before it.
constexpr ByteView recordInMessage(ByteView message)
{
    return message.subspan(std::min(recordPlace(message, 0), message.size()));
}

/// What the item that starts at `item` says of its length, and its log code.
constexpr std::size_t itemLength(RecordView bytes, std::size_t item)
{
    return bytes.u16(item);
}
constexpr std::uint16_t itemCode(RecordView bytes, std::size_t item)
{
    return bytes.u16(item + ItemLengthSize);
}

/// The code by which a record is routed.
constexpr std::uint32_t routingCode(RecordView record)
{
    return itemCode(record, RecordTypeSize) | (record.u8(0) == ExtraRecord ? ExtraStream : 0);
}

/// The code by which a message is routed; none when it is too short or of an unknown type. A wrapper's bytes count
/// towards the least length, on purpose: the generators take such a message, too.
constexpr std::optional<std::uint32_t> routedCode(ByteView message)
{
    const RecordView record(recordInMessage(message));
    if (message.size() < RecordHeaderSize || !isRecordType(record.u8(0)))
        return std::nullopt;
    return routingCode(record);
}

/// What follows the header; empty for a record that ends before it.
constexpr ByteView recordPayload(RecordView record)
{
    return record.from(RecordHeaderSize);
}

/// For a type byte that is neither of the two; not every generator drops the record as the line says.
inline constexpr const char* InvalidTypeLine = "Invalid log type: %x. Dropping.";

} // namespace spectrel
