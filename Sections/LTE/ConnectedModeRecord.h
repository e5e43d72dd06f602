#pragma once

#include "LogGenerator/Template/RepeatedGroup.h"
#include "Sections/LTE/Levels.h"

#include <cstddef>
#include <cstdint>

/// Connected-mode intra-frequency measurement, code 0xB179: the serving cell, the measured neighbours and, after them,
/// the detected cells.
namespace spectrel::ConnectedModeRecord {

constexpr std::uint32_t Code = 0xB179;
constexpr std::size_t MinimumLength = 29;

/// Filtered levels: quarters of a dB from -140 dBm, eighths of a dB from -20 dB.
constexpr Formatter FilteredRSRP = fineLevel<4, -140, LevelUnit::dBm>;
constexpr Formatter FilteredRSRQ = fineLevel<8, -20, LevelUnit::dB>;

constexpr RepeatedGroup measuredNeighbours(RecordView record)
{
    return {29, 6, record.u8(27)};
}

constexpr RepeatedGroup detectedCells(RecordView record)
{
    const RepeatedGroup measured = measuredNeighbours(record);
    return {measured.start + measured.entrySize * measured.count, 2, record.u8(28)};
}

} // namespace spectrel::ConnectedModeRecord
