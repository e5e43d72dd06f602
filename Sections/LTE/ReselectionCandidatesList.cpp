#include "Sections/LTE/ReselectionCandidatesList.h"

#include "LogGenerator/Template/Fields.h"
#include "Sections/LTE/LTEKind.h"
#include "Sections/LTE/ReselectionRecord.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord =
    lteKind("Reselection Candidates List", ReselectionRecord::Code, ReselectionRecord::MinimumLength);

using View = ReselectionRecord::View;

// Offsets from a candidate's start.
constexpr std::array<Field, 1> CommonFields {{
    {0, Width::U16, "Candidate Priority", decimal},
}};
constexpr std::array<Field, 2> LTEFields {{
    {4, Width::U16, "E ARFCN", decimal},
    {6, bits(7, 9), "Cell ID", decimal},
}};
constexpr std::array<Field, 2> UTRANFields {{
    {4, Width::U16, "U ARFCN", decimal},
    {6, Width::U16, "PSC", decimal},
}};
constexpr std::array<Field, 3> GERANFields {{
    {4, Width::U16, "ARFCN", decimal},
    {6, Width::U8, "Band", decimal},
    {7, Width::U8, "BSIC ID", decimal},
}};
constexpr std::array<Field, 3> CDMAFields {{
    {4, Width::U8, "Band", decimal},
    {8, Width::U16, "Channel", decimal},
    {10, Width::U16, "Pilot", decimal},
}};

struct CandidateTechnology {
    std::string_view name;
    View view;
    std::span<const Field> fields;
};

/// By the technology's number; any other is "??" and has no further fields.
constexpr std::array<CandidateTechnology, 5> Technologies {{
    {"LTE", View::LTE, LTEFields},
    {"UTRAN", View::UTRAN, UTRANFields},
    {"GERAN", View::GERAN, GERANFields},
    {"CDMA1XRTT", View::CDMA, CDMAFields},
    {"CDMAHRPD", View::CDMA, CDMAFields},
}};

DictionaryRef candidateEntry(RecordView record, const ReselectionRecord& candidates, std::size_t index)
{
    const DictionaryRef entry = entryWithFields(record, CommonFields, candidates.candidate(index));
    const std::size_t number = candidates.technology(index);
    if (number >= Technologies.size()) {
        entry->setText("Candidate RAT Type", "??");
        return entry;
    }
    const CandidateTechnology& technology = Technologies[number];
    entry->setText("Candidate RAT Type", technology.name);
    storeFields(record, technology.fields, entry, candidates.candidateAs(technology.view, index));
    return entry;
}

} // namespace

ReselectionCandidatesList::ReselectionCandidatesList(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void ReselectionCandidatesList::decode(RecordView record)
{
    clearList();
    const ReselectionRecord reselection(record);
    if (reselection.candidatesToRead() == 0)
        return;
    List candidates;
    for (std::size_t index = 0; index < reselection.candidatesToRead(); ++index)
        candidates.append(candidateEntry(record, reselection, index));
    replaceList(candidates);
}

} // namespace spectrel
