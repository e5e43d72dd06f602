#include "Sections/GSMUMTS/UMTS/NonRankedUMTSSet.h"

#include "Platform/SystemLog.h"

namespace spectrel {

NonRankedUMTSSet::NonRankedUMTSSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view NonRankedUMTSSet::getSectionName() const
{
    return "Non-Ranked UMTS Set";
}

std::vector<std::uint32_t> NonRankedUMTSSet::getLogCodeArray() const
{
    return {};
}

void NonRankedUMTSSet::updateWithData(RecordView, std::uint32_t)
{
    SPECTREL_LOG(Priority::Warning, "NonRankedUMTSSet");
}

} // namespace spectrel
