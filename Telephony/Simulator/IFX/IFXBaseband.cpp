#include "Telephony/Encoders/IFXMessage.h"
#include "Telephony/Simulator/Baseband.h"
#include "Telephony/Simulator/IFX/IFXWorld.h"

#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::array<Cadence<IFXWorld>, 1> Cadences {{
    {2s, true, [](const IFXWorld& world, Moment time) { return ifxMessage(world.report(), time); }},
}};

} // namespace

std::unique_ptr<Baseband> makeIFXBaseband(Scene scene, std::uint32_t seed)
{
    return std::make_unique<SteadyBaseband<IFXWorld>>(Technology::IFX, scene, seed, Cadences);
}

} // namespace spectrel
