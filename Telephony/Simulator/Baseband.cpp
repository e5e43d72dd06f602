#include "Telephony/Simulator/Baseband.h"

namespace spectrel {

std::unique_ptr<Baseband> makeBaseband(Technology technology, Scene scene, std::uint32_t seed)
{
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
