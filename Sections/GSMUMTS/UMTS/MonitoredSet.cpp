#include "Sections/GSMUMTS/UMTS/MonitoredSet.h"

#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/UMTS/UMTSCellSets.h"

namespace spectrel {

MonitoredSet::MonitoredSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view MonitoredSet::getSectionName() const
{
    return "Monitored Set";
}

std::vector<std::uint32_t> MonitoredSet::getLogCodeArray() const
{
    return {UMTSCellSetsCode};
}

void MonitoredSet::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "MonitoredSet");
    if (logCode != UMTSCellSetsCode)
        return logUnknownMessage(logCode);
    if (record.size() >= UMTSCellSetsMinimumLength && sectionRef.list())
        clearElementsInArray(*sectionRef.list());
}

} // namespace spectrel
