#include "Sections/LTE/ReselectionCandidatesList.h"

#include "LogGenerator/Template/Fields.h"
#include "Sections/LTE/LTEKind.h"
#include "Sections/LTE/ReselectionRecord.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord =
    lteKind("Reselection Candidates List", ReselectionRecord::Code, ReselectionRecord::MinimumLength);

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

/// A candidate's further fields; technologies `first` to `last` have them.
struct View {
    std::uint16_t first;
    std::uint16_t last;
    std::span<const Field> fields;
};
constexpr View LTEView {0, 0, LTEFields};
constexpr View UTRANView {1, 1, UTRANFields};
constexpr View GERANView {2, 2, GERANFields};
constexpr View CDMAView {3, 4, CDMAFields};

struct CandidateTechnology {
    std::string_view name;
    const View& view;
};

/// By the technology's number; any other is "??" and has no further fields.
constexpr std::array<CandidateTechnology, 5> Technologies {{
    {"LTE", LTEView},
    {"UTRAN", UTRANView},
    {"GERAN", GERANView},
    {"CDMA1XRTT", CDMAView},
    {"CDMAHRPD", CDMAView},
}};

DictionaryRef candidateEntry(RecordView record, std::size_t index)
{
    const DictionaryRef entry =
        entryWithFields(record, CommonFields, ReselectionRecord::candidates(record).entry(index));
    const std::size_t number = ReselectionRecord::technology(record, index);
    if (number >= Technologies.size()) {
        entry->setText("Candidate RAT Type", "??");
        return entry;
    }
    const auto& [name, view] = Technologies[number];
    entry->setText("Candidate RAT Type", name);
    storeFields(record, view.fields, entry, ReselectionRecord::candidateAs(record, index, view.first, view.last));
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
    List candidates;
    for (std::size_t index = 0; index < ReselectionRecord::candidatesToRead(record); ++index)
        candidates.append(candidateEntry(record, index));
    replaceList(candidates);
}

} // namespace spectrel
