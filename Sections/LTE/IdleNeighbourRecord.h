#pragma once

#include "LogGenerator/Template/RecordView.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

/// Idle-mode neighbour measurement, code 0xB180: 1 to 32 entries, never none, of 20 bytes. Their count is not checked
/// against the record's length.
class IdleNeighbourRecord {
public:
    static constexpr std::uint32_t Code = 0xB180;
    static constexpr std::size_t MinimumLength = 21;

    explicit IdleNeighbourRecord(RecordView record)
        : _last(record.bits(19, 6, 5))
    {
    }
    /// The index of the last entry, 0 to 31.
    std::size_t last() const
    {
        return _last;
    }
    /// Where an entry starts. An index above the last raises `ArrayOutOfBoundsException`.
    std::size_t neighbour(std::size_t index) const;

private:
    std::size_t _last;
};

} // namespace spectrel
