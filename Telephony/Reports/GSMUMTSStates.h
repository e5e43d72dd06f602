#pragma once

#include <cstdint>

/// The states of a GSM/UMTS phone's protocols. Each value is the code that the baseband reports; only those that the
/// simulated phone takes stand here.
namespace spectrel {

/// Which network the phone is on; none while it searches.
enum class RadioSystem : std::uint8_t { None, UMTS, GSM };

/// UMTS radio resource control (3GPP TS 25.331, 7.1).
enum class RRCState : std::uint8_t { Disconnected, Connecting, CellFACH, CellDCH, CellPCH, URAPCH };

/// GSM radio resources (3GPP TS 44.018, 3.1).
enum class RRState : std::uint8_t {
    Inactive = 0,
    CellSelection = 3,
    PLMNListConstruction = 4,
    Idle = 5,
    CellReselection = 6,
    ConnectionPending = 7,
    DataTransfer = 9,
    ConnectionRelease = 11,
    FromUMTSByHandover = 13,
    FromUMTSByReselection = 14,
    ToUMTSByReselection = 18,
    ToUMTSByHandover = 19,
    FromUMTSByOrder = 21, // cell change order
};

/// Circuit-switched mobility management (3GPP TS 24.008, 4.1.2.1).
enum class MMState : std::uint8_t {
    Null = 0,
    LocationUpdateInitiated = 3,
    WaitForOutgoingConnection = 5,
    ConnectionActive = 6,
    WaitForNetworkCommand = 9,
    LocationUpdateRejected = 10,
    WaitForRRConnectionToUpdate = 13,
    WaitForRRConnectionToCall = 14,
    Idle = 19,
};

enum class MMSubState : std::uint8_t {
    None = 0,
    PLMNSearch = 2,
    LimitedService = 3,
    LocationUpdateNeeded = 5,
    NoCellAvailable = 6,
    NormalService = 8,
};

/// Packet-switched mobility management (3GPP TS 24.008, 4.1.3.1).
enum class GMMState : std::uint8_t {
    Null = 0,
    Deregistered = 1,
    RegisteredInitiated = 2,
    Registered = 3,
    RoutingAreaUpdateInitiated = 5,
    ServiceRequestInitiated = 6,
};

enum class GMMSubState : std::uint8_t {
    NormalService = 0,
    LimitedService = 1,
    AttachNeeded = 2,
    NoCellAvailable = 5,
    PLMNSearch = 6,
    Suspended = 7,
    UpdateNeeded = 8,
    None = 12,
};

/// Update status U1 to U3 of the SIM (3GPP TS 24.008, 4.1.2.2), and GU1 to GU3 for packets. U3 by area: the location
/// area or the routing area is not allowed.
enum class UpdateStatus : std::uint8_t { Updated = 0, NotUpdated = 1, AreaNotAllowed = 3 };

enum class RegistrationState : std::uint8_t { Inactive = 0, Idle = 1, Registering = 2, AutomaticSearch = 5 };

enum class PLMNSelection : std::uint8_t { Automatic = 0, Limited = 2 };

enum class ServiceType : std::uint8_t { None = 0, CircuitOnly = 1, CircuitAndPacket = 3, Limited = 4 };

} // namespace spectrel
