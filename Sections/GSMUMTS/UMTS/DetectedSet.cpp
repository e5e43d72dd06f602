#include "Sections/GSMUMTS/UMTS/DetectedSet.h"

#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/UMTS/UMTSCellSets.h"

namespace spectrel {

DetectedSet::DetectedSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view DetectedSet::getSectionName() const
{
    return "Detected Set";
}

std::vector<std::uint32_t> DetectedSet::getLogCodeArray() const
{
    return {UMTSCellSetsCode};
}

void DetectedSet::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "DetectedSet");
    if (logCode != UMTSCellSetsCode)
        return logUnknownMessage(logCode);
    if (record.size() >= UMTSCellSetsMinimumLength && sectionRef.list())
        clearElementsInArray(*sectionRef.list());
}

} // namespace spectrel
