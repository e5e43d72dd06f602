#include "Sections/GSMUMTS/Mobility/ProcessCO.h"

#include "LogGenerator/Template/Fields.h"
#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"

#include <array>

namespace spectrel {

namespace {

/// Circuit-switched mobility management, code 0x7131, in writing order.
constexpr std::array<Field, 1> MMStateFields {{
    {13, Width::U8, "MM State", named<MMStates>},
}};

constexpr std::array<RecordLayout, 2> Layouts {{
    {MMStateCode, 16, MMStateFields},
    {RegistrationStateCode, RegistrationStateMinimumLength, RegistrationStateFields},
}};

} // namespace

ProcessCO::ProcessCO(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view ProcessCO::getSectionName() const
{
    return "Process CO";
}

std::vector<std::uint32_t> ProcessCO::getLogCodeArray() const
{
    return {MMStateCode, RegistrationStateCode};
}

void ProcessCO::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "ProcessCS"); // the sibling, not itself: kept on purpose
    if (!storeRecord(record, logCode, Layouts, sectionRef))
        logUnknownMessage(logCode);
}

} // namespace spectrel
