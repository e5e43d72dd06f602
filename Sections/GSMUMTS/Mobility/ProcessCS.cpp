#include "Sections/GSMUMTS/Mobility/ProcessCS.h"

#include "LogGenerator/Template/Fields.h"
#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::array<std::string_view, 9> MMSubStates {{
    "MM_NULL_SUBSTATE",
    "MM_NO_IMSI",
    "MM_PLMN_SEARCH",
    "MM_LIMITED_SERVICE",
    "MM_ATTEMPTING_TO_UPDATE",
    "MM_LOCATION_UPDATE_NEEDED",
    "MM_NO_CELL_AVAILABLE",
    "MM_PLMN_SEARCH_NORMAL_SERVICE",
    "MM_NORMAL_SERVICE",
}};

/// Location-update statuses, although the key speaks of a cause.
constexpr std::array<std::string_view, 4> UpdateStatuses {{
    "UPDATED",
    "NOT_UPDATED",
    "ROAMING_NOT_ALLOWED",
    "LOCATION_AREA_NOT_ALLOWED",
}};

/// Circuit-switched mobility management, code 0x7131, in writing order.
constexpr std::array<Field, 3> MMStateFields {{
    {13, Width::U8, "MM State", named<MMStates>},
    {14, Width::U8, "MM Sub State", named<MMSubStates>},
    {15, Width::U8, "LU Reject Cause", named<UpdateStatuses>},
}};

constexpr std::array<RecordLayout, 2> Layouts {{
    {MMStateCode, 16, MMStateFields},
    {RegistrationStateCode, RegistrationStateMinimumLength, RegistrationStateFields},
}};

} // namespace

ProcessCS::ProcessCS(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view ProcessCS::getSectionName() const
{
    return "Process CS";
}

std::vector<std::uint32_t> ProcessCS::getLogCodeArray() const
{
    return {MMStateCode, RegistrationStateCode};
}

void ProcessCS::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "ProcessCS");
    if (!storeRecord(record, logCode, Layouts, sectionRef))
        logUnknownMessage(logCode);
}

} // namespace spectrel
