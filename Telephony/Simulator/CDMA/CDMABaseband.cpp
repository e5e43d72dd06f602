#include "Telephony/Encoders/CDMARecords.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/CDMA/CDMAWorld.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::array<Cadence<CDMAWorld>, 8> Cadences {{
    {5s, true, cdmaSystemInformationRecord},
    {1s, true, evdoAirLinkRecord},
    {1s, false, cdmaSearcherRecord},
    {100ms, false, cdmaFrameRecord},
    {1s, false, evdoPilotsRecord},
    {1s, false, evdoFingersRecord},
    {1s, false, evdoForwardCountersRecord},
    {2s, false, evdoReverseCountersRecord},
}};

} // namespace

std::unique_ptr<Baseband> makeCDMABaseband(Scene scene, std::uint32_t seed)
{
    return std::make_unique<SteadyBaseband<CDMAWorld>>(Technology::CDMA, scene, seed, Cadences);
}

} // namespace spectrel
