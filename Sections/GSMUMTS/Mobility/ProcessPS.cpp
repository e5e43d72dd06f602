#include "Sections/GSMUMTS/Mobility/ProcessPS.h"

#include "LogGenerator/Template/Fields.h"
#include "Platform/SystemLog.h"
#include "Sections/GSMUMTS/Mobility/MobilityManagement.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::uint32_t GMMStateCode = 0x7130;

constexpr std::array<std::string_view, 7> GMMStates {{
    "GMM_NULL",
    "GMM_DEREGISTERED",
    "GMM_REGISTERED_INITIATED",
    "GMM_REGISTERED",
    "GMM_DEREGISTERED_INITIATED",
    "GMM_ROUTING_AREA_UPDATE_INITIATED",
    "GMM_SERVICE_REQUEST_INITIATED",
}};

constexpr std::array<std::string_view, 13> GMMSubStates {{
    "GMM_NORMAL_SERVICE",
    "GMM_LIMITED_SERVICE",
    "GMM_ATTACH_NEEDED",
    "GMM_ATTEMPTING_TO_ATTACH",
    "GMM_NO_IMSI",
    "GMM_NO_CELL_AVAILABLE",
    "GMM_PLMN_SEARCH",
    "GMM_SUSPENDED",
    "GMM_UPDATE_NEEDED",
    "GMM_ATTEMPING_TO_UPDATE", // a T short, as it is shown
    "GMM_ATTEMPTING_TO_UPDATE_MM",
    "GMM_IMSI_DETACH_INITIATED",
    "GMM_NULL_SUBSTATE",
}};

/// Update statuses, although the key speaks of a cause.
constexpr std::array<std::string_view, 4> UpdateStatuses {{
    "GMM_GU1_UPDATED",
    "GMM_GU2_NOT_UPDATED",
    "GMM_GU3_PLMN_NOT_ALLOWED",
    "GMM_GU3_ROUTING_AREA_NOT_ALLOWED",
}};

/// Packet-switched mobility management, code 0x7130, in writing order.
constexpr std::array<Field, 3> GMMStateFields {{
    {13, Width::U8, "MM State", named<GMMStates>},
    {14, Width::U8, "MM Sub State", named<GMMSubStates>},
    {15, Width::U8, "Attach Reject Cause", named<UpdateStatuses>},
}};

constexpr std::array<RecordLayout, 2> Layouts {{
    {GMMStateCode, 16, GMMStateFields},
    {RegistrationStateCode, RegistrationStateMinimumLength, RegistrationStateFields},
}};

} // namespace

ProcessPS::ProcessPS(ClassDictionary& dict, CodeDictionary& codeDict)
{
    enterInto(dict, codeDict);
}

std::string_view ProcessPS::getSectionName() const
{
    return "Process PS";
}

std::vector<std::uint32_t> ProcessPS::getLogCodeArray() const
{
    return {GMMStateCode, RegistrationStateCode};
}

void ProcessPS::updateWithData(RecordView record, std::uint32_t logCode)
{
    SPECTREL_LOG(Priority::Warning, "ProcessPS");
    if (!storeRecord(record, logCode, Layouts, sectionRef))
        logUnknownMessage(logCode);
}

} // namespace spectrel
