#include "Telephony/Encoders/CDMARecords.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/CDMA/CDMAWorld.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

template <auto Encode> Bytes reported(const CDMAWorld& world, Moment time)
{
    return Encode(world.report(), time);
}

constexpr std::array<Cadence<CDMAWorld>, 8> Cadences {{
    {5s, true, reported<cdmaSystemInformationRecord>},
    {1s, true, reported<evdoAirLinkRecord>},
    {1s, false, reported<cdmaSearcherRecord>},
    {100ms, false, reported<cdmaFrameRecord>},
    {1s, false, reported<evdoPilotsRecord>},
    {1s, false, reported<evdoFingersRecord>},
    {1s, false, reported<evdoForwardCountersRecord>},
    {2s, false, reported<evdoReverseCountersRecord>},
}};

} // namespace

std::unique_ptr<Baseband> makeCDMABaseband(Scene scene, std::uint32_t seed)
{
    return std::make_unique<SteadyBaseband<CDMAWorld>>(Technology::CDMA, scene, seed, Cadences);
}

} // namespace spectrel
