#include "Sections/GSMUMTS/GSM/NonRankedGSMSet.h"

#include "Platform/SystemLog.h"

namespace spectrel {

NonRankedGSMSet::NonRankedGSMSet(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view NonRankedGSMSet::getSectionName() const
{
    return "Non-Ranked GSM Set";
}

std::vector<std::uint32_t> NonRankedGSMSet::getLogCodeArray() const
{
    return {};
}

void NonRankedGSMSet::updateWithData(RecordView, std::uint32_t)
{
    SPECTREL_LOG(Priority::Warning, "NonRankedGSMSet");
}

} // namespace spectrel
