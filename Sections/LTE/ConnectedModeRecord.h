#pragma once

#include "LogGenerator/Template/RecordView.h"
#include "Sections/LTE/Levels.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

/// Connected-mode intra-frequency measurement, code 0xB179: the serving cell, the measured neighbours and, after them,
/// the detected cells. Counts are not checked against the record's length.
class ConnectedModeRecord {
public:
    static constexpr std::uint32_t Code = 0xB179;
    static constexpr std::size_t MinimumLength = 29;
    /// Filtered levels: quarters of a dBm from -140 dBm, eighths of a dB from -20 dB.
    static constexpr Formatter FilteredRSRP = fineLevel<4, -140, LevelUnit::dBm>;
    static constexpr Formatter FilteredRSRQ = fineLevel<8, -20, LevelUnit::dB>;

    explicit ConnectedModeRecord(RecordView record)
        : _measured(record.u8(27))
        , _detected(record.u8(28))
    {
    }
    std::size_t measuredCount() const
    {
        return _measured;
    }
    std::size_t detectedCount() const
    {
        return _detected;
    }
    /// Where an entry starts. An index not below the count raises `ArrayOutOfBoundsException`.
    std::size_t measuredNeighbour(std::size_t index) const;
    std::size_t detectedCell(std::size_t index) const;

private:
    std::size_t _measured;
    std::size_t _detected;
};

} // namespace spectrel
