#include "Telephony/Simulator/Propagation.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace spectrel {

void Shadowing::advance(std::chrono::milliseconds step, Dice& dice)
{
    const double seconds = std::chrono::duration<double>(step).count();
    _decibels = std::clamp(_decibels + dice.between(-1, 1) * std::sqrt(seconds), -6.0, 6.0);
}

double Valley::lossAt(const Journey& journey) const
{
    const double out = journey.distanceTo((from + to) / 2, 0) / ((to - from) / 2);
    return out >= 1 ? 0 : loss * (1 + std::cos(out * std::numbers::pi)) / 2;
}

double OpenWater::gainAt(const Journey& journey) const
{
    constexpr double Gain = 50; // free space and a high mast, instead of streets
    return journey.scene() == Scene::Overshoot ? Valley {from, to, Gain}.lossAt(journey) : 0;
}

double pathLoss(double metres)
{
    return 128.1 + 37.6 * std::log10(std::max(metres, 35.0) / 1000);
}

} // namespace spectrel
