#pragma once

#include "LogGenerator/Template/ArrayOutOfBoundsException.h"
#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// Reselection candidates, code 0xB186.
namespace ReselectionRecord {

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

} // namespace ReselectionRecord

/// The cell that the phone would leave.
class ReselectionCandidatesMisc final : public SectionOf<ReselectionCandidatesMisc> {
    static constexpr std::array<Field, 3> Fields {{
        {13, Width::U8, "Version", decimal},
        {15, Width::U16, "Serving EARFCN", decimal},
        {17, Width::U16, "Serving Cell ID", decimal},
    }};
    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = ReselectionRecord::Code, .minimumLength = ReselectionRecord::MinimumLength, .fields = Fields},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Reselection Candidates", .layouts = Layouts};
};

/// The cells of every radio technology that the phone could move to, with the priority of each. Every record of the
/// code rebuilds the list.
class ReselectionCandidatesList final : public SectionOf<ReselectionCandidatesList> {
    // Offsets from a candidate's start.
    static constexpr std::array<Field, 1> CommonFields {{
        {0, Width::U16, "Candidate Priority", decimal},
    }};
    static constexpr std::array<Field, 2> LTEFields {{
        {4, Width::U16, "E ARFCN", decimal},
        {6, bits(7, 9), "Cell ID", decimal},
    }};
    static constexpr std::array<Field, 2> UTRANFields {{
        {4, Width::U16, "U ARFCN", decimal},
        {6, Width::U16, "PSC", decimal},
    }};
    static constexpr std::array<Field, 3> GERANFields {{
        {4, Width::U16, "ARFCN", decimal},
        {6, Width::U8, "Band", decimal},
        {7, Width::U8, "BSIC ID", decimal},
    }};
    static constexpr std::array<Field, 3> CDMAFields {{
        {4, Width::U8, "Band", decimal},
        {8, Width::U16, "Channel", decimal},
        {10, Width::U16, "Pilot", decimal},
    }};

    /// A candidate's further fields; technologies `first` to `last` have them.
    struct CandidateTechnology {
        std::string_view name;
        std::uint16_t first;
        std::uint16_t last;
        std::span<const Field> fields;
    };
    /// By the technology's number; any other is "??" and has no further fields.
    static constexpr std::array<CandidateTechnology, 5> Technologies {{
        {"LTE", 0, 0, LTEFields},
        {"UTRAN", 1, 1, UTRANFields},
        {"GERAN", 2, 2, GERANFields},
        {"CDMA1XRTT", 3, 4, CDMAFields},
        {"CDMAHRPD", 3, 4, CDMAFields},
    }};

    static DictionaryRef candidateEntry(RecordView record, std::size_t index)
    {
        const std::size_t start = ReselectionRecord::candidates(record).entry(index);
        const DictionaryRef entry = entryWithFields(record, CommonFields, start);
        const std::size_t number = ReselectionRecord::technology(record, index);
        if (number >= Technologies.size()) {
            entry->setText("Candidate RAT Type", "??");
            return entry;
        }
        const auto& [name, first, last, fields] = Technologies[number];
        entry->setText("Candidate RAT Type", name);
        spectrel::storeFields(record, fields, *entry, ReselectionRecord::candidateAs(record, index, first, last));
        return entry;
    }
    void listCandidates(RecordView record)
    {
        List candidates;
        for (std::size_t index = 0; index < ReselectionRecord::candidatesToRead(record); ++index)
            candidates.append(candidateEntry(record, index));
        replaceList(candidates);
    }

    static constexpr std::array<RecordLayout, 1> Layouts {{
        {.code = ReselectionRecord::Code,
            .minimumLength = ReselectionRecord::MinimumLength,
            .hook = hook<&ReselectionCandidatesList::listCandidates>},
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Reselection Candidates List", .layouts = Layouts};
};

} // namespace spectrel
