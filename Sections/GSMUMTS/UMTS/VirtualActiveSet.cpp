#include "Sections/GSMUMTS/UMTS/VirtualActiveSet.h"

#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/UMTS/UMTSCellSets.h"

namespace spectrel {

VirtualActiveSet::VirtualActiveSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view VirtualActiveSet::getSectionName() const
{
    return "Virtual Active Set";
}

std::vector<std::uint32_t> VirtualActiveSet::getLogCodeArray() const
{
    return {UMTSCellSetsCode};
}

void VirtualActiveSet::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "VirtualActiveSet");
    if (logCode != UMTSCellSetsCode)
        return logUnknownMessage(logCode);
    if (record.size() >= UMTSCellSetsMinimumLength && sectionRef.list())
        clearElementsInArray(*sectionRef.list());
}

} // namespace spectrel
