#pragma once

#include "LogGenerator/Template/RepeatedGroup.h"

#include <cstddef>
#include <cstdint>

/// Transport-channel quality, code 0xD00C.
namespace spectrel::TransportChannelRecord {

constexpr std::uint32_t Code = 0xD00C;
constexpr std::size_t MinimumLength = 17;

constexpr RepeatedGroup transportChannels(RecordView record)
{
    return {17, 2, record.bits(14, 6, 6)};
}

/// They do not follow the transport channels directly: kept on purpose.
constexpr RepeatedGroup codedCompositeChannels(RecordView record)
{
    return {289 + 34 * transportChannels(record).count, 8, record.bits(15, 4, 4)};
}

/// The six time slots of a coded composite channel that starts at `channel`: a ratio of one byte each.
constexpr RepeatedGroup timeSlots(std::size_t channel)
{
    return {channel + 2, 1, 6};
}

} // namespace spectrel::TransportChannelRecord
