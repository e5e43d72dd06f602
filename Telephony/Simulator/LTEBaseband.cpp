#include "Telephony/Encoders/LTERecords.h"
#include "Telephony/Encoders/PropertyListRecords.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/LTEWorld.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::array<Cadence<LTEWorld>, 5> Cadences {{
    {10s, true, [](const LTEWorld&, Moment time) { return simFilesRecord(time); }},
    {2s, true, [](const LTEWorld& world, Moment time) { return lteCellInformationRecord(world, time); }},
    {1s, true,
        [](const LTEWorld& world, Moment time) {
            return contextsRecord(world.bytesReceived(), world.bytesSent(), time);
        }},
    {400ms, false, [](const LTEWorld& world, Moment time) { return lteServingCellRecord(world.servingCell(), time); }},
    {800ms, false, [](const LTEWorld& world, Moment time) { return lteAntennasRecord(world.servingCell(), time); }},
}};

} // namespace

std::unique_ptr<Baseband> makeLTEBaseband(Scene scene, std::uint32_t seed)
{
    return std::make_unique<SteadyBaseband<LTEWorld>>(Technology::LTE, scene, seed, Cadences);
}

} // namespace spectrel
