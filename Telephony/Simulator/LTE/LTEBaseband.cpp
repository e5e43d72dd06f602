#include "Telephony/Encoders/LTERecords.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/LTE/LTEWorld.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

Bytes connectedMode(const LTEWorld& world, Moment time)
{
    return world.isConnected() ? lteConnectedModeRecord(world.connectedReport(), time) : Bytes();
}

Bytes servingMeasurement(const LTEWorld& world, Moment time)
{
    return world.isConnected() ? Bytes() : lteServingMeasurementRecord(world.idleMode().serving(), time);
}

Bytes neighbourMeasurement(const LTEWorld& world, Moment time)
{
    return world.isConnected() ? Bytes() : lteNeighbourMeasurementRecord(world.idleMode().neighbours(), time);
}

Bytes reselection(const LTEWorld& world, Moment time)
{
    return world.isConnected() ? Bytes() : lteReselectionRecord(world.idleMode().candidate(), time);
}

Bytes cellInformation(const LTEWorld& world, Moment time)
{
    constexpr std::size_t Neighbours = 4;
    return lteCellInformationRecord(world.servingCell(), world.neighbours(Neighbours), time);
}

constexpr std::array<Cadence<LTEWorld>, 9> Cadences {{
    {30s, true, [](const LTEWorld&, Moment time) { return simFilesRecord(time); }},
    {5s, true, cellInformation},
    {2s, true,
        [](const LTEWorld& world, Moment time) {
            return contextsRecord(world.bytesReceived(), world.bytesSent(), time);
        }},
    {400ms, false, [](const LTEWorld& world, Moment time) { return lteServingCellRecord(world.servingCell(), time); }},
    {800ms, false, [](const LTEWorld& world, Moment time) { return lteAntennasRecord(world.servingCell(), time); }},
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

} // namespace spectrel
