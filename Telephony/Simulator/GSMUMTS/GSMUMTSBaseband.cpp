#include "Telephony/Encoders/GPRSRecords.h"
#include "Telephony/Encoders/GSMRecords.h"
#include "Telephony/Encoders/GSMUMTSPropertyLists.h"
#include "Telephony/Encoders/MobilityRecords.h"
#include "Telephony/Encoders/UMTSRecords.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/GSMUMTS/GSMUMTSWorld.h"
#include "Telephony/Simulator/TechnologyPart.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;
using World = GSMUMTSWorld;

template <auto Part, auto Encode> Bytes reported(const World& world, Moment time)
{
    return Encode(world.now().*Part, time);
}

template <auto Part> bool hasChanged(const World& world)
{
    return world.now().*Part != world.before().*Part;
}

/// A record when the part of the situation has changed.
template <auto Part, auto Make> Bytes onChange(const World& world, Moment time)
{
    return hasChanged<Part>(world) ? Make(world, time) : Bytes();
}

template <RadioSystem System, auto Make> Bytes on(const World& world, Moment time)
{
    return world.system() == System ? Make(world, time) : Bytes();
}

template <auto Make> Bytes onUMTS(const World& world, Moment time)
{
    return on<RadioSystem::UMTS, Make>(world, time);
}

template <auto Make> Bytes onGSM(const World& world, Moment time)
{
    return on<RadioSystem::GSM, Make>(world, time);
}

template <auto Encode> Bytes gprs(const World& world, Moment time)
{
    return Encode(world.now().gprs.value_or(GPRSParameters()), time);
}

/// Timers and counters have no value for "not known yet".
template <auto Encode> Bytes gprsOnceRead(const World& world, Moment time)
{
    return world.gsm().hasReadSystemInformation() ? gprs<Encode>(world, time) : Bytes();
}

constexpr auto mm = reported<&Situation::mm, mmStateRecord>;
constexpr auto gmm = reported<&Situation::gmm, gmmStateRecord>;
constexpr auto registration = reported<&Situation::registration, registrationRecord>;
constexpr auto network = reported<&Situation::network, servingNetworkRecord>;
constexpr auto rrc = reported<&Situation::rrc, rrcStateRecord>;
constexpr auto ciphering = reported<&Situation::isCiphering, cipheringRecord>;
constexpr auto rr = reported<&Situation::rr, rrStateRecord>;
constexpr auto dtx = reported<&Situation::usesDTX, dtxRecord>;
constexpr auto hopping = reported<&Situation::hopping, mobileAllocationRecord>;

Bytes equivalents(const World& world, Moment time)
{
    return equivalentNetworksRecord(world.equivalentNetworks(), time);
}

Bytes cellSets(const World& world, Moment time)
{
    return cellSetsRecord(world.umts().cellSets(), time);
}

Bytes ranking(const World& world, Moment time)
{
    return rankingRecord(world.ranking(), time);
}

Bytes umtsCell(const World& world, Moment time)
{
    return world.now().umtsCell ? umtsServingCellRecord(*world.now().umtsCell, time) : Bytes();
}

Bytes transmitPower(const World& world, Moment time)
{
    return transmitPowerRecord(world.now().isSending ? world.traffic().powers() : TransmitPowers(), time);
}

Bytes transmitPowerWhileSending(const World& world, Moment time)
{
    return world.now().isSending ? transmitPower(world, time) : Bytes();
}

Bytes blockErrors(const World& world, Moment time)
{
    return blockErrorRecord(world.traffic().blocks(), time);
}

Bytes blockErrorsWhileDedicated(const World& world, Moment time)
{
    return world.now().isOnDCH ? blockErrors(world, time) : Bytes();
}

Bytes hsdpa(const World& world, Moment time)
{
    return world.traffic().hsdpa().subFrames > 0 ? hsdpaRecord(world.traffic().hsdpa(), time) : Bytes();
}

Bytes gsmCell(const World& world, Moment time)
{
    return world.now().gsmCell ? gsmServingCellRecord(*world.now().gsmCell, time) : Bytes();
}

Bytes gsmMeasurement(const World& world, Moment time)
{
    return gsmMeasurementRecord(world.gsm().measurement(), time);
}

Bytes neighbourIdentities(const World& world, Moment time)
{
    return neighbourIdentitiesRecord(world.gsm().identified(), time);
}

Bytes dedicatedChannel(const World& world, Moment time)
{
    return world.now().isDedicated ? dedicatedChannelRecord(world.gsm().dedicatedArfcn(), time) : Bytes();
}

Bytes hoppingInCalls(const World& world, Moment time)
{
    return world.now().isDedicated ? hopping(world, time) : Bytes();
}

Bytes simFiles(const World& world, Moment time)
{
    return gsmumtsSIMFilesRecord(world.now().knownLocation, world.now().knownRouting, time);
}

Bytes cellInformation(const World& world, Moment time)
{
    return gsmumtsCellInformationRecord(world.cellInformation(), time);
}

Bytes packetContexts(const World& world, Moment time)
{
    return packetContextsRecord(world.session(), time);
}

constexpr auto Cadences = std::to_array<Cadence<World>>({
    {30s, true, simFiles},
    {100ms, false, onChange<&Situation::knownLocation, simFiles>},
    {100ms, false, onChange<&Situation::knownRouting, simFiles>},
    {10s, true, registration},
    {100ms, false, onChange<&Situation::registration, registration>},
    {10s, true, mm},
    {100ms, false, onChange<&Situation::mm, mm>},
    {10s, true, gmm},
    {100ms, false, onChange<&Situation::gmm, gmm>},
    {10s, true, network},
    {100ms, false, onChange<&Situation::network, network>},
    {30s, true, equivalents},
    {100ms, false, onChange<&Situation::knownLocation, equivalents>}, // the update's answer names them

    {10s, true, onUMTS<rrc>},
    {100ms, false, onChange<&Situation::rrc, rrc>},
    {10s, true, onUMTS<ciphering>},
    {100ms, false, onChange<&Situation::isCiphering, ciphering>},
    {10s, true, umtsCell},
    {100ms, false, onChange<&Situation::umtsCell, umtsCell>},
    {600ms, false, onUMTS<cellSets>},
    {100ms, false, onChange<&Situation::umtsCell, cellSets>}, // its strongest cell is the serving one at any moment
    {1s, true, onUMTS<ranking>},
    {100ms, false, onChange<&Situation::measuresGSM, onUMTS<ranking>>},
    {5s, false, onGSM<ranking>},
    {500ms, false, transmitPowerWhileSending},
    {100ms, false, onChange<&Situation::isSending, transmitPower>},
    {1s, false, blockErrorsWhileDedicated},
    {100ms, false, onChange<&Situation::isOnDCH, blockErrors>},
    {1s, false, hsdpa},

    {10s, true, rr},
    {100ms, false, onChange<&Situation::rr, rr>},
    {5s, true, gsmCell},
    {100ms, false, onChange<&Situation::gsmCell, gsmCell>},
    {3s, false, onGSM<neighbourIdentities>},
    {500ms, false, onGSM<gsmMeasurement>},
    {2s, false, dedicatedChannel},
    {100ms, false, onChange<&Situation::isDedicated, dedicatedChannel>},
    {100ms, false, onChange<&Situation::usesDTX, dtx>},
    {5s, true, onGSM<dtx>},
    {100ms, false, onChange<&Situation::hopping, hopping>},
    {5s, true, hoppingInCalls},
    {5s, true, onGSM<gprs<gprsSystemInformationRecord>>},
    {5s, true, onGSM<gprs<gprsAccessRecord>>},
    {5s, true, onGSM<gprsOnceRead<gprsTimersRecord>>},
    {5s, true, onGSM<gprsOnceRead<gprsBroadcastRecord>>},
    {5s, true, onGSM<gprsOnceRead<gprsStatusRecord>>},
    {100ms, false, onChange<&Situation::gprs, onGSM<gprs<gprsSystemInformationRecord>>>},
    {100ms, false, onChange<&Situation::gprs, onGSM<gprs<gprsAccessRecord>>>},
    {100ms, false, onChange<&Situation::gprs, onGSM<gprsOnceRead<gprsTimersRecord>>>},

    {5s, true, cellInformation},
    {100ms, false, onChange<&Situation::umtsCell, cellInformation>},
    {100ms, false, onChange<&Situation::gsmCell, cellInformation>},
    {5s, true, packetContexts},
    {100ms, false, onChange<&Situation::hasSession, packetContexts>},
});

} // namespace

std::unique_ptr<Baseband> makeGSMUMTSBaseband(Scene scene, std::uint32_t seed)
{
    return std::make_unique<SteadyBaseband<World>>(Technology::GSM, scene, seed, Cadences);
}

std::unique_ptr<TechnologyPart> makeGSMPart(std::uint32_t seed)
{
    return std::make_unique<SteadyPart<World>>(Technology::GSM, seed, Cadences);
}

} // namespace spectrel
