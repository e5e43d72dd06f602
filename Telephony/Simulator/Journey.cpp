#include "Telephony/Simulator/Journey.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

namespace {

constexpr int Tunnels = 3; // on the ring
constexpr double TunnelLength = 400; // metres
constexpr double TunnelMouth = 30; // metres until nothing is heard
constexpr double TunnelLoss = 100; // dB

} // namespace

Journey::Journey(Scene scene, double length, Dice& dice)
    : _scene(scene)
    , _length(length)
    , _pace(paceOf(scene))
    , _position(dice.between(0, length))
    , _speed((_pace.min + _pace.max) / 2)
{
    if (scene == Scene::Journey)
        _ownDice.emplace(dice.number());
}

void Journey::stayAround(double centre, double reach)
{
    _position = centre;
    _turning = Turning {centre, reach};
}

void Journey::advance(std::chrono::milliseconds step, Dice& dice)
{
    const double seconds = std::chrono::duration<double>(step).count();
    Dice& ownDice = _ownDice ? *_ownDice : dice;
    _speed = std::clamp(_speed + ownDice.between(-1, 1) * seconds, _pace.min, _pace.max);
    if (_turning && std::fabs(ahead(_turning->centre)) >= _turning->reach)
        _direction = ahead(_turning->centre) > 0 ? 1 : -1;
    _position = std::fmod(_position + _direction * _speed * seconds, _length);
    if (_position < 0)
        _position += _length;
}

double Journey::distanceTo(double position, double offset) const
{
    const double direct = std::fabs(_position - position);
    return std::hypot(std::min(direct, _length - direct), offset);
}

double Journey::tunnelLoss() const
{
    if (_scene != Scene::Tunnel)
        return 0;
    const double distance = _length / Tunnels;
    const double toMiddle = std::fabs(std::remainder(_position - distance / 2, distance));
    return TunnelLoss * std::clamp((TunnelLength / 2 - toMiddle) / TunnelMouth, 0.0, 1.0);
}

double Journey::ahead(double position) const
{
    return std::remainder(position - _position, _length);
}

} // namespace spectrel
