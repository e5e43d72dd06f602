#include "Telephony/Simulator/Baseband.h"

#include "Telephony/Simulator/JourneyBaseband.h"

namespace spectrel {

std::unique_ptr<Baseband> makeBaseband(Technology technology, Scene scene, std::uint32_t seed)
{
    if (!hasScene(technology, scene))
        return nullptr;
    if (scene == Scene::Journey)
        return std::make_unique<JourneyBaseband>(technology, seed);
    switch (technology) {
    case Technology::IFX:
        return makeIFXBaseband(scene, seed);
    case Technology::GSM:
        return makeGSMUMTSBaseband(scene, seed);
    case Technology::CDMA:
        return makeCDMABaseband(scene, seed);
    case Technology::LTE:
        return makeLTEBaseband(scene, seed);
    case Technology::UTRAN:
        return makeUTRANBaseband(scene, seed);
    }
    return nullptr;
}

} // namespace spectrel
