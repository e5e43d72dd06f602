#include "Sections/GSMUMTS/Mobility/CellChangeCounters.h"

#include "Platform/SystemLog.h"

namespace spectrel {

CellChangeCounters::CellChangeCounters(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view CellChangeCounters::getSectionName() const
{
    return "Cell Change Counters";
}

std::vector<std::uint32_t> CellChangeCounters::getLogCodeArray() const
{
    return {};
}

void CellChangeCounters::updateWithData(RecordView, std::uint32_t)
{
    SPECTREL_LOG(Priority::Warning, "CellChangeCounters");
}

} // namespace spectrel
