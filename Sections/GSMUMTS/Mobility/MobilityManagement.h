#pragma once

#include "LogGenerator/Template/RecordSection.h"

#include <array>

namespace spectrel {

/// Mobility-management states (3GPP TS 24.008, 4.1.2.1.1), indexed by their code. Some codes have no name.
inline constexpr std::array<std::string_view, 26> MMStates {{
    "MM_NULL",
    "Unknown",
    "Unknown",
    "MM_LOCATION_UPDATE_INITIATED",
    "Unknown",
    "MM_WAIT_FOR_OUTGOING_MM_CONNECTION",
    "MM_CONNECTION_ACTIVE",
    "MM_IMSI_DETACH_INITIATED",
    "MM_PROCESS_CM_SERVICE_PROMPT",
    "MM_WAIT_FOR_NETWORK_COMMAND",
    "MM_LOCATION_UPDATE_REJECTED",
    "Unknown",
    "Unknown",
    "MM_WAIT_FOR_RR_CONNECTION_LU",
    "MM_WAIT_FOR_RR_CONNECTION_MM",
    "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH",
    "Unknown",
    "MM_REESTABLISHMENT_INITIATED",
    "MM_WAIT_FOR_RR_ACTIVE",
    "MM_IDLE",
    "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION", // the blanks of this and the next are shown
    "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT",
    "MM_WAIT_FOR_REESTABLISH_DECISION",
    "MM_LOCATION_UPDATING_PENDING",
    "Unknown",
    "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED",
}};

inline constexpr std::array<std::string_view, 7> RegistrationStates {{
    "REG_STATE_INACTIVE",
    "REG_STATE_IDLE",
    "REG_STATE_REGISTERING",
    "REG_STATE_DEREGISTERING",
    "REG_STATE_MANUAL_SEARCH",
    "REG_STATE_AUTOMATIC_SEARCH",
    "REG_STATE_OFFLINE",
}};

inline constexpr std::array<Field, 1> RegistrationStateFields {{
    {13, Width::U8, "MM Service State", named<RegistrationStates>},
}};

/// The registration state, which all three sections show.
inline constexpr RecordLayout RegistrationStateLayout {
    .code = 0x7132, .minimumLength = 16, .fields = RegistrationStateFields};

/// The mobility-management state and the registration state.
class ProcessCO final : public SectionOf<ProcessCO> {
    static constexpr std::array<Field, 1> MMStateFields {{
        {13, Width::U8, "MM State", named<MMStates>},
    }};
    static constexpr std::array<RecordLayout, 2> Layouts {{
        {.code = 0x7131, .minimumLength = 16, .fields = MMStateFields},
        RegistrationStateLayout,
    }};

public:
    using SectionOf::SectionOf;
    // Traces the sibling, not itself: kept on purpose.
    static constexpr SectionDescription Description {.name = "Process CO", .trace = "ProcessCS", .layouts = Layouts};
};

/// Circuit-switched mobility management and the registration state.
class ProcessCS final : public SectionOf<ProcessCS> {
    static constexpr std::array<std::string_view, 9> MMSubStates {{
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
    static constexpr std::array<std::string_view, 4> UpdateStatuses {{
        "UPDATED",
        "NOT_UPDATED",
        "ROAMING_NOT_ALLOWED",
        "LOCATION_AREA_NOT_ALLOWED",
    }};

    /// In writing order.
    static constexpr std::array<Field, 3> MMStateFields {{
        {13, Width::U8, "MM State", named<MMStates>},
        {14, Width::U8, "MM Sub State", named<MMSubStates>},
        {15, Width::U8, "LU Reject Cause", named<UpdateStatuses>},
    }};

    static constexpr std::array<RecordLayout, 2> Layouts {{
        {.code = 0x7131, .minimumLength = 16, .fields = MMStateFields},
        RegistrationStateLayout,
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Process CS", .trace = "ProcessCS", .layouts = Layouts};
};

/// Packet-switched mobility management (GMM) and the registration state.
class ProcessPS final : public SectionOf<ProcessPS> {
    static constexpr std::array<std::string_view, 7> GMMStates {{
        "GMM_NULL",
        "GMM_DEREGISTERED",
        "GMM_REGISTERED_INITIATED",
        "GMM_REGISTERED",
        "GMM_DEREGISTERED_INITIATED",
        "GMM_ROUTING_AREA_UPDATE_INITIATED",
        "GMM_SERVICE_REQUEST_INITIATED",
    }};

    static constexpr std::array<std::string_view, 13> GMMSubStates {{
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
    static constexpr std::array<std::string_view, 4> UpdateStatuses {{
        "GMM_GU1_UPDATED",
        "GMM_GU2_NOT_UPDATED",
        "GMM_GU3_PLMN_NOT_ALLOWED",
        "GMM_GU3_ROUTING_AREA_NOT_ALLOWED",
    }};

    /// In writing order.
    static constexpr std::array<Field, 3> GMMStateFields {{
        {13, Width::U8, "MM State", named<GMMStates>},
        {14, Width::U8, "MM Sub State", named<GMMSubStates>},
        {15, Width::U8, "Attach Reject Cause", named<UpdateStatuses>},
    }};

    static constexpr std::array<RecordLayout, 2> Layouts {{
        {.code = 0x7130, .minimumLength = 16, .fields = GMMStateFields},
        RegistrationStateLayout,
    }};

public:
    using SectionOf::SectionOf;
    static constexpr SectionDescription Description {.name = "Process PS", .trace = "ProcessPS", .layouts = Layouts};
};

} // namespace spectrel
