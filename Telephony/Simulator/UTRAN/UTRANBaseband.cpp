#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Encoders/UTRANRecords.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/TechnologyPart.h"
#include "Telephony/Simulator/UTRAN/UTRANWorld.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

Bytes transportChannels(const UTRANWorld& world, Moment time)
{
    const TransportReport report = world.transportChannels();
    return report.channels.empty() ? Bytes() : utranTransportChannelRecord(report, time);
}

/// Those of an ended connection would stay on the screen.
Bytes noTransportChannels(const UTRANWorld& world, Moment time)
{
    const TransportReport report = world.transportChannels();
    return report.channels.empty() ? utranTransportChannelRecord(report, time) : Bytes();
}

constexpr std::array<Cadence<UTRANWorld>, 9> Cadences {{
    {30s, true, [](const UTRANWorld& world, Moment time) { return utranSIMFilesRecord(world.servingCell(), time); }},
    {5s, true,
        [](const UTRANWorld& world, Moment time) {
            return utranCellInformationRecord(world.servingCell(), world.otherCells(), time);
        }},
    {2s, true,
        [](const UTRANWorld& world, Moment time) {
            return packetContextRecord(world.bytesReceived(), world.bytesSent(), time);
        }},
    {500ms, true,
        [](const UTRANWorld& world, Moment time) { return utranRRCRecord(world.mode(), world.isInService(), time); }},
    {1s, true,
        [](const UTRANWorld& world, Moment time) {
            return utranServingCellRecord(world.servingCell(), world.isInService(), time);
        }},
    {600ms, true, [](const UTRANWorld& world, Moment time) { return utranNeighbourRecord(world.neighbours(), time); }},
    {2s, true,
        [](const UTRANWorld& world, Moment time) { return utranGSMNeighbourRecord(world.gsmNeighbours(), time); }},
    {400ms, false, transportChannels},
    {2s, false, noTransportChannels},
}};

} // namespace

std::unique_ptr<Baseband> makeUTRANBaseband(Scene scene, std::uint32_t seed)
{
    return std::make_unique<SteadyBaseband<UTRANWorld>>(Technology::UTRAN, scene, seed, Cadences);
}

std::unique_ptr<TechnologyPart> makeUTRANPart(std::uint32_t seed)
{
    return std::make_unique<SteadyPart<UTRANWorld>>(Technology::UTRAN, seed, Cadences);
}

} // namespace spectrel
