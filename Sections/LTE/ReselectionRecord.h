#pragma once

#include "LogGenerator/Template/RepeatedGroup.h"

#include <cstddef>
#include <cstdint>

/// Reselection candidates, code 0xB186.
namespace spectrel::ReselectionRecord {

constexpr std::uint32_t Code = 0xB186;
constexpr std::size_t MinimumLength = 21;

/// Candidates stand 4 bytes apart while the fields of one reach up to 12 bytes from its start, so that successive ones
/// overlap: kept on purpose.
constexpr RepeatedGroup candidates(RecordView record)
{
    return {21, 4, record.u16(19)};
}

/// How many candidates are read: the low byte of their count.
constexpr std::size_t candidatesToRead(RecordView record)
{
    return record.u8(19);
}

/// A candidate's radio access technology: 0 LTE, 1 UTRAN, 2 GERAN, 3 CDMA 1xRTT, 4 CDMA HRPD.
constexpr std::uint16_t technology(RecordView record, std::size_t index)
{
    return record.u16(candidates(record).entry(index) + 2);
}

/// Where a candidate starts that is read as one of the technologies `first` to `last`. One of another technology raises
/// `ArrayOutOfBoundsException`, as an index beyond the candidates does.
constexpr std::size_t candidateAs(RecordView record, std::size_t index, std::uint16_t first, std::uint16_t last)
{
    const std::uint16_t actual = technology(record, index);
    if (actual < first || actual > last)
        throw ArrayOutOfBoundsException();
    return candidates(record).entry(index);
}

} // namespace spectrel::ReselectionRecord
