#include "Telephony/Simulator/GSMUMTS/MobilityManagement.h"

#include "Telephony/Simulator/Demand.h"

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr auto PowerOnTime = 1s;
constexpr auto DecisionTime = 300ms; // from a need to the first message
constexpr auto UpdateTime = 900ms; // request to acceptance
constexpr auto AttachTime = 1100ms;
constexpr auto ServiceTime = 300ms;
constexpr auto CallSetupTime = 600ms;
constexpr auto NetworkReleaseTime = 400ms;

} // namespace

void MobilityManagement::advance(std::chrono::milliseconds step, const Inputs& inputs)
{
    _inputs = inputs;
    advanceMM(step);
    advanceGMM(step);
}

void MobilityManagement::advanceMM(std::chrono::milliseconds step)
{
    _inMM += step;
    const bool isIdle = _mm.state == MMState::Idle;
    keepTime(_updateNeeded, isIdle && !isSearching() && !isLocationKnown() && !isForbidden(), step);
    if (const MMState next = nextMM(); next != _mm.state) {
        if (_mm.state == MMState::LocationUpdateInitiated)
            noteAnswer();
        _mm.state = next;
        _inMM = 0ms;
    }
    _mm.subState = mmSubState();
}

/// Of the network, to a location update (3GPP TS 24.008, 4.4.4.6 and 4.4.4.7).
void MobilityManagement::noteAnswer()
{
    switch (nextMM()) {
    case MMState::WaitForNetworkCommand:
        _location = _inputs.place;
        _mm.status = UpdateStatus::Updated;
        _forbiddenArea.reset();
        return;
    case MMState::LocationUpdateRejected:
        _location = _routing = {};
        _forbiddenArea = _inputs.place.locationArea;
        _mm.status = _gmm.status = UpdateStatus::AreaNotAllowed;
        _gmm.state = GMMState::Deregistered;
        return;
    default:
        return;
    }
}

MMState MobilityManagement::nextMM() const
{
    if (isSearching() && _mm.state != MMState::Null)
        return MMState::Idle; // without a cell every procedure ends
    switch (_mm.state) {
    case MMState::Null:
        return _inMM >= PowerOnTime ? MMState::Idle : MMState::Null;
    case MMState::Idle:
        return afterIdle();
    case MMState::WaitForRRConnectionToUpdate:
        return _inputs.isConnected ? MMState::LocationUpdateInitiated : _mm.state;
    case MMState::LocationUpdateInitiated:
        if (!_inputs.isConnected)
            return MMState::Idle; // lost: it begins anew
        if (_inMM < UpdateTime)
            return _mm.state;
        return _inputs.isRejected ? MMState::LocationUpdateRejected : MMState::WaitForNetworkCommand;
    case MMState::WaitForRRConnectionToCall:
        if (!_inputs.wantsCall)
            return MMState::Idle;
        return _inputs.isConnected ? MMState::WaitForOutgoingConnection : _mm.state;
    case MMState::WaitForOutgoingConnection:
        return _inMM >= CallSetupTime ? MMState::ConnectionActive : _mm.state;
    case MMState::ConnectionActive:
        return _inputs.wantsCall ? _mm.state : MMState::WaitForNetworkCommand;
    case MMState::WaitForNetworkCommand:
    case MMState::LocationUpdateRejected:
        return _inMM >= NetworkReleaseTime ? MMState::Idle : _mm.state;
    }
    return _mm.state;
}

MMState MobilityManagement::afterIdle() const
{
    if (_updateNeeded >= DecisionTime)
        return MMState::WaitForRRConnectionToUpdate;
    if (isLocationKnown() && _inputs.wantsCall)
        return MMState::WaitForRRConnectionToCall;
    return MMState::Idle;
}

MMSubState MobilityManagement::mmSubState() const
{
    if (_mm.state != MMState::Idle)
        return MMSubState::None;
    if (isSearching())
        return _mm.status == UpdateStatus::Updated ? MMSubState::NoCellAvailable : MMSubState::PLMNSearch;
    if (isForbidden())
        return MMSubState::LimitedService;
    return isLocationKnown() ? MMSubState::NormalService : MMSubState::LocationUpdateNeeded;
}

void MobilityManagement::advanceGMM(std::chrono::milliseconds step)
{
    _inGMM += step;
    const bool mayUpdate = (_mm.state == MMState::Idle && isLocationKnown()) || _mm.state == MMState::ConnectionActive;
    keepTime(_routingNeeded, mayUpdate && !isSearching() && !isSuspended() && !isRoutingKnown(), step);
    const bool isExchanging = _gmm.state == GMMState::RegisteredInitiated
        || _gmm.state == GMMState::RoutingAreaUpdateInitiated || _gmm.state == GMMState::ServiceRequestInitiated;
    keepTime(_exchange, isExchanging && _inputs.isConnected, step);
    if (const GMMState next = nextGMM(); next != _gmm.state) {
        const bool isAnswered = next == GMMState::Registered && _gmm.state != GMMState::ServiceRequestInitiated;
        if (isAnswered) {
            _routing = _inputs.place;
            _gmm.status = UpdateStatus::Updated;
        }
        _gmm.state = next;
        _inGMM = 0ms;
        _exchange = 0ms;
    }
    _gmm.subState = gmmSubState();
}

GMMState MobilityManagement::nextGMM() const
{
    switch (_gmm.state) {
    case GMMState::Null:
        return _inGMM >= PowerOnTime ? GMMState::Deregistered : _gmm.state;
    case GMMState::Deregistered:
        return _routingNeeded >= DecisionTime ? GMMState::RegisteredInitiated : _gmm.state;
    case GMMState::RegisteredInitiated:
        return _exchange >= AttachTime ? GMMState::Registered : _gmm.state;
    case GMMState::Registered:
        return afterRegistered();
    case GMMState::RoutingAreaUpdateInitiated:
        return _exchange >= UpdateTime ? GMMState::Registered : _gmm.state;
    case GMMState::ServiceRequestInitiated: {
        const bool isMoot = _inputs.place.system != RadioSystem::UMTS; // there are none elsewhere
        return isMoot || _exchange >= ServiceTime ? GMMState::Registered : _gmm.state;
    }
    }
    return _gmm.state;
}

GMMState MobilityManagement::afterRegistered() const
{
    if (_routingNeeded >= DecisionTime)
        return GMMState::RoutingAreaUpdateInitiated;
    if (!isSuspended() && _inputs.wantsTransfer && isRoutingKnown() && _inputs.place.system == RadioSystem::UMTS
        && !_inputs.isConnected)
        return GMMState::ServiceRequestInitiated;
    return _gmm.state;
}

GMMSubState MobilityManagement::gmmSubState() const
{
    if (_gmm.state == GMMState::Deregistered)
        return isSearching() ? GMMSubState::PLMNSearch
            : isForbidden()  ? GMMSubState::LimitedService
                             : GMMSubState::AttachNeeded;
    if (_gmm.state != GMMState::Registered)
        return GMMSubState::None;
    if (isSearching())
        return GMMSubState::NoCellAvailable;
    if (isSuspended())
        return GMMSubState::Suspended;
    return isRoutingKnown() ? GMMSubState::NormalService : GMMSubState::UpdateNeeded;
}

bool MobilityManagement::isForbidden() const
{
    return !isSearching() && _forbiddenArea == _inputs.place.locationArea;
}

bool MobilityManagement::isLocationKnown() const
{
    return !isSearching() && _location.locationArea == _inputs.place.locationArea;
}

bool MobilityManagement::isRoutingKnown() const
{
    return !isSearching() && _routing == _inputs.place;
}

/// A phone of class B has no packets in a GSM call.
bool MobilityManagement::isSuspended() const
{
    return _inputs.place.system == RadioSystem::GSM && isCalling();
}

bool MobilityManagement::isSignalling() const
{
    return _mm.state == MMState::WaitForRRConnectionToUpdate || _mm.state == MMState::LocationUpdateInitiated
        || _gmm.state == GMMState::RegisteredInitiated || _gmm.state == GMMState::RoutingAreaUpdateInitiated
        || _gmm.state == GMMState::ServiceRequestInitiated;
}

bool MobilityManagement::isCalling() const
{
    return _mm.state == MMState::WaitForRRConnectionToCall || _mm.state == MMState::WaitForOutgoingConnection
        || _mm.state == MMState::ConnectionActive;
}

bool MobilityManagement::isAttached() const
{
    return _routing.system != RadioSystem::None;
}

bool MobilityManagement::mayTransfer() const
{
    return _gmm.state == GMMState::Registered && _gmm.subState == GMMSubState::NormalService
        && (_inputs.isConnected || _inputs.place.system == RadioSystem::GSM);
}

RegistrationReport MobilityManagement::registration() const
{
    if (_mm.state == MMState::Null)
        return {RegistrationState::Inactive, PLMNSelection::Automatic};
    if (isSearching())
        return {RegistrationState::AutomaticSearch, PLMNSelection::Automatic};
    const bool isUpdating = _mm.state == MMState::WaitForRRConnectionToUpdate
        || _mm.state == MMState::LocationUpdateInitiated || _gmm.state == GMMState::RegisteredInitiated
        || _gmm.state == GMMState::RoutingAreaUpdateInitiated;
    return {isUpdating ? RegistrationState::Registering : RegistrationState::Idle,
        _mm.status == UpdateStatus::Updated ? PLMNSelection::Automatic : PLMNSelection::Limited};
}

ServiceType MobilityManagement::service() const
{
    if (isSearching())
        return ServiceType::None;
    if (_location.system == RadioSystem::None)
        return ServiceType::Limited;
    return isAttached() && !isSuspended() ? ServiceType::CircuitAndPacket : ServiceType::CircuitOnly;
}

} // namespace spectrel
