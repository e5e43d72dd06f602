#include "Telephony/Simulator/MastRoad.h"

namespace spectrel {

namespace {

constexpr double PacingReach = 0.18; // of the distance between two masts

} // namespace

MastRoad::MastRoad(Scene scene, std::size_t masts, double spacing, Dice& dice)
    : _journey(scene, static_cast<double>(masts) * spacing, dice)
    , _water {4.2 * spacing, 4.8 * spacing}
{
    for (std::size_t mast = 0; mast < masts; ++mast) {
        const double position = static_cast<double>(mast) * spacing + dice.between(-0.1, 0.1) * spacing;
        const double offset = dice.between(30, 120);
        _masts.push_back({position, offset, Shadowing(dice)});
    }
    if (scene == Scene::PingPong)
        _journey.stayAround(1.5 * spacing, PacingReach * spacing);
}

void MastRoad::advance(std::chrono::milliseconds step, Dice& dice)
{
    _journey.advance(step, dice);
    for (Mast& mast : _masts)
        mast.shadowing.advance(step, dice);
}

double MastRoad::loss(std::size_t mast) const
{
    const double loss = pathLoss(distance(mast)) + _masts[mast].shadowing.decibels();
    return loss + _journey.tunnelLoss() - (mast == 0 ? _water.gainAt(_journey) : 0);
}

double MastRoad::distance(std::size_t mast) const
{
    return _journey.distanceTo(_masts[mast].position, _masts[mast].offset);
}

} // namespace spectrel
