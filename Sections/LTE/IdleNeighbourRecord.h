#pragma once

#include "LogGenerator/Template/RepeatedGroup.h"

#include <cstddef>
#include <cstdint>

/// Idle-mode neighbour measurement, code 0xB180.
namespace spectrel::IdleNeighbourRecord {

constexpr std::uint32_t Code = 0xB180;
constexpr std::size_t MinimumLength = 21;

/// The record tells the index of the last neighbour, so there are 1 to 32, never none.
constexpr RepeatedGroup neighbours(RecordView record)
{
    return {21, 20, record.bits(19, 6, 5) + 1};
}

} // namespace spectrel::IdleNeighbourRecord
