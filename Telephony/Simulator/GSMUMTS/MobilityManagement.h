#pragma once

#include "Telephony/Reports/GSMUMTSReports.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace spectrel {

/// A phone's mobility management, from power-on: location updates and calls, attach, routing area updates and service
/// requests, as 3GPP TS 24.008, 4.4 and 4.7 run them in a network of mode II (the one after the other).
class MobilityManagement {
public:
    /// What happens around it in a step.
    struct Inputs {
        Place place;
        bool isConnected = false; // signalling gets through
        bool isRejected = false; // the network rejects updates: the location area is not allowed
        bool wantsCall = false;
        bool wantsTransfer = false;
    };

    void advance(std::chrono::milliseconds step, const Inputs& inputs);

    const MMReport& mm() const
    {
        return _mm;
    }
    const GMMReport& gmm() const
    {
        return _gmm;
    }
    RegistrationReport registration() const;
    ServiceType service() const;
    /// The place that the network knows; of no system before the first update.
    const Place& knownLocation() const
    {
        return _location;
    }
    const Place& knownRouting() const
    {
        return _routing;
    }

    /// An update or a request needs a connection.
    bool isSignalling() const;
    bool isCalling() const;
    bool isAttached() const;
    /// Attached, and nothing is in the way of a transfer.
    bool mayTransfer() const;

private:
    void advanceMM(std::chrono::milliseconds step);
    void advanceGMM(std::chrono::milliseconds step);
    MMState nextMM() const;
    MMState afterIdle() const;
    GMMState nextGMM() const;
    GMMState afterRegistered() const;
    MMSubState mmSubState() const;
    GMMSubState gmmSubState() const;
    bool isSearching() const
    {
        return _inputs.place.system == RadioSystem::None;
    }
    bool isLocationKnown() const;
    bool isRoutingKnown() const;
    bool isSuspended() const;
    bool isForbidden() const;
    void noteAnswer();

    Inputs _inputs;
    Place _location;
    Place _routing;
    std::optional<std::uint16_t> _forbiddenArea; // where the last update was rejected
    MMReport _mm;
    GMMReport _gmm;
    std::chrono::milliseconds _inMM {0};
    std::chrono::milliseconds _inGMM {0};
    std::chrono::milliseconds _updateNeeded {0}; // for so long, and nothing in the way
    std::chrono::milliseconds _routingNeeded {0};
    std::chrono::milliseconds _exchange {0}; // connected in a procedure of packet mobility
};

} // namespace spectrel
