#include "Telephony/Encoders/LTERecords.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/LTE/LTEWorld.h"
#include "Telephony/Simulator/TechnologyPart.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

Bytes connectedMode(const LTEWorld& world, Moment time)
{
    return world.isConnected() ? lteConnectedModeRecord(world.connectedReport(), time) : Bytes();
}

bool isCamping(const LTEWorld& world)
{
    return world.isInService() && !world.isConnected();
}

Bytes servingMeasurement(const LTEWorld& world, Moment time)
{
    return isCamping(world) ? lteServingMeasurementRecord(world.idleMode().serving(), time) : Bytes();
}

Bytes neighbourMeasurement(const LTEWorld& world, Moment time)
{
    return isCamping(world) ? lteNeighbourMeasurementRecord(world.idleMode().neighbours(), time) : Bytes();
}

Bytes reselection(const LTEWorld& world, Moment time)
{
    return isCamping(world) ? lteReselectionRecord(world.idleMode().candidate(), time) : Bytes();
}

Bytes cellInformation(const LTEWorld& world, Moment time)
{
    constexpr std::size_t Neighbours = 4;
    if (!world.isInService())
        return {};
    return lteCellInformationRecord(world.servingCell(), world.neighbours(Neighbours), time);
}

template <auto Encode> Bytes ofServingCell(const LTEWorld& world, Moment time)
{
    return world.isInService() ? Encode(world.servingCell(), time) : Bytes();
}

constexpr std::array<Cadence<LTEWorld>, 9> Cadences {{
    {30s, true, [](const LTEWorld&, Moment time) { return simFilesRecord(time); }},
    {5s, true, cellInformation},
    {2s, true,
        [](const LTEWorld& world, Moment time) {
            return contextsRecord(world.bytesReceived(), world.bytesSent(), time);
        }},
    {400ms, false, ofServingCell<lteServingCellRecord>},
    {800ms, false, ofServingCell<lteAntennasRecord>},
    {200ms, false, connectedMode},
    {LTEIdleMode::Cycle, true, servingMeasurement},
    {LTEIdleMode::Cycle, true, neighbourMeasurement},
    {LTEIdleMode::Cycle, true, reselection},
}};

} // namespace

std::unique_ptr<Baseband> makeLTEBaseband(Scene scene, std::uint32_t seed)
{
    return std::make_unique<SteadyBaseband<LTEWorld>>(Technology::LTE, scene, seed, Cadences);
}

std::unique_ptr<TechnologyPart> makeLTEPart(std::uint32_t seed)
{
    return std::make_unique<SteadyPart<LTEWorld>>(Technology::LTE, seed, Cadences);
}

} // namespace spectrel
