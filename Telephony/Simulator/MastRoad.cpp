#include "Telephony/Simulator/MastRoad.h"

namespace spectrel {

MastRoad::MastRoad(Scene scene, std::size_t masts, double spacing, Dice& dice)
    : _journey(scene, static_cast<double>(masts) * spacing, dice)
{
    for (std::size_t mast = 0; mast < masts; ++mast) {
        const double position = static_cast<double>(mast) * spacing + dice.between(-0.1, 0.1) * spacing;
        const double offset = dice.between(30, 120);
        _masts.push_back({position, offset, Shadowing(dice)});
    }
}

void MastRoad::advance(std::chrono::milliseconds step, Dice& dice)
{
    _journey.advance(step, dice);
    for (Mast& mast : _masts)
        mast.shadowing.advance(step, dice);
}

double MastRoad::loss(std::size_t mast) const
{
    return pathLoss(distance(mast)) + _masts[mast].shadowing.decibels();
}

double MastRoad::distance(std::size_t mast) const
{
    return _journey.distanceTo(_masts[mast].position, _masts[mast].offset);
}

} // namespace spectrel
