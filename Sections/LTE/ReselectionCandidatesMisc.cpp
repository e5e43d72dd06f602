#include "Sections/LTE/ReselectionCandidatesMisc.h"

#include "LogGenerator/Template/Fields.h"
#include "Sections/LTE/LTEKind.h"
#include "Sections/LTE/ReselectionRecord.h"

#include <array>

namespace spectrel {

namespace {

constexpr RecordKind OwnRecord =
    lteKind("Reselection Candidates", ReselectionRecord::Code, ReselectionRecord::MinimumLength);

constexpr std::array<Field, 3> Fields {{
    {13, Width::U8, "Version", decimal},
    {15, Width::U16, "Serving EARFCN", decimal},
    {17, Width::U16, "Serving Cell ID", decimal},
}};

} // namespace

ReselectionCandidatesMisc::ReselectionCandidatesMisc(ClassDictionary& dict, CodeDictionary& codeDict)
    : RecordSection(OwnRecord, dict, codeDict)
{
}

void ReselectionCandidatesMisc::decode(RecordView record)
{
    storeFields(record, Fields, sectionRef);
}

} // namespace spectrel
