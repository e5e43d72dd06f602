#pragma once

#include "LogGenerator/Template/Fields.h"

#include <array>
#include <cstdint>
#include <string_view>

/// What the mobility-management sections share.
namespace spectrel {

constexpr std::uint32_t MMStateCode = 0x7131; // circuit-switched mobility management
constexpr std::uint32_t RegistrationStateCode = 0x7132;
constexpr std::size_t RegistrationStateMinimumLength = 16; // bytes, 13-byte header included

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

/// Registration state, code 0x7132.
inline constexpr std::array<Field, 1> RegistrationStateFields {{
    {13, Width::U8, "MM Service State", named<RegistrationStates>},
}};

} // namespace spectrel
