#include "Sections/GSMUMTS/GSM/CodingScheme.h"

#include "Platform/SystemLog.h"

namespace spectrel {

CodingScheme::CodingScheme(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view CodingScheme::getSectionName() const
{
    return "Coding Scheme";
}

std::vector<std::uint32_t> CodingScheme::getLogCodeArray() const
{
    return {};
}

void CodingScheme::updateWithData(RecordView, std::uint32_t)
{
    SPECTREL_LOG(Priority::Warning, "CellChangeCounters"); // not its own name: kept on purpose
}

} // namespace spectrel
