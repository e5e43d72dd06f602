#pragma once

#include "LogGenerator/Template/RecordView.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

/// Reselection candidates, code 0xB186. Candidates stand 4 bytes apart while the fields of one reach up to 12 bytes
/// from its start, so that neighbouring ones overlap: kept on purpose. Their count is not checked against the record's
/// length.
class ReselectionRecord {
public:
    static constexpr std::uint32_t Code = 0xB186;
    static constexpr std::size_t MinimumLength = 21;

    /// The layouts of what follows a candidate's priority and technology.
    enum class View : std::uint8_t { LTE, UTRAN, GERAN, CDMA };

    explicit ReselectionRecord(RecordView record)
        : _record(record)
    {
    }
    /// How many candidates to read: the low byte of the count.
    std::size_t candidatesToRead() const
    {
        return _record.u8(19);
    }
    /// Where a candidate starts. An index not below the whole 16-bit count raises `ArrayOutOfBoundsException`.
    std::size_t candidate(std::size_t index) const;
    /// A candidate's radio access technology: 0 LTE, 1 UTRAN, 2 GERAN, 3 CDMA 1xRTT, 4 CDMA HRPD.
    std::uint16_t technology(std::size_t index) const;
    /// Where a candidate starts that has the view's fields; one of another technology raises
    /// `ArrayOutOfBoundsException` too.
    std::size_t candidateAs(View view, std::size_t index) const;

private:
    RecordView _record;
};

} // namespace spectrel
