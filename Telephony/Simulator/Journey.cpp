#include "Telephony/Simulator/Journey.h"

#include "Values/Table.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace spectrel {

namespace {

struct Pace {
    std::string_view name;
    Scene scene;
    double minSpeed; // metres a second
    double maxSpeed;
};

constexpr std::array<Pace, 4> Paces {{
    {"still", Scene::Still, 0, 0},
    {"walk", Scene::Walk, 0.8, 2},
    {"drive", Scene::Drive, 6, 22},
    {"stress", Scene::Stress, 30, 50},
}};

const Pace& paceOf(Scene scene)
{
    return *std::ranges::find(Paces, scene, &Pace::scene);
}

} // namespace

bool sceneNamed(std::string_view name, Scene& scene)
{
    const auto* pace = findRow(Paces, name, &Pace::name);
    if (pace)
        scene = pace->scene;
    return pace != nullptr;
}

Journey::Journey(Scene scene, double length, Dice& dice)
    : _length(length)
    , _minSpeed(paceOf(scene).minSpeed)
    , _maxSpeed(paceOf(scene).maxSpeed)
    , _position(dice.between(0, length))
    , _speed((_minSpeed + _maxSpeed) / 2)
{
}

void Journey::advance(std::chrono::milliseconds step, Dice& dice)
{
    const double seconds = std::chrono::duration<double>(step).count();
    _speed = std::clamp(_speed + dice.between(-1, 1) * seconds, _minSpeed, _maxSpeed);
    _position = std::fmod(_position + _speed * seconds, _length);
}

double Journey::distanceTo(double position, double offset) const
{
    const double direct = std::fabs(_position - position);
    return std::hypot(std::min(direct, _length - direct), offset);
}

double Journey::ahead(double position) const
{
    return std::remainder(position - _position, _length);
}

} // namespace spectrel
