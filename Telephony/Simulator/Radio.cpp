#include "Telephony/Simulator/Radio.h"

#include "Values/Table.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <numbers>

namespace spectrel {

namespace {

struct Pace {
    std::string_view name;
    Scene scene;
    double slowest; // metres a second
    double fastest;
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

double Dice::between(double from, double to)
{
    return from + (to - from) * static_cast<double>(number()) / static_cast<double>(std::mt19937::max());
}

Journey::Journey(Scene scene, double length, Dice& dice)
    : _length(length)
    , _slowest(paceOf(scene).slowest)
    , _fastest(paceOf(scene).fastest)
    , _position(dice.between(0, length))
    , _speed((_slowest + _fastest) / 2)
{
}

void Journey::advance(std::chrono::milliseconds step, Dice& dice)
{
    const double seconds = std::chrono::duration<double>(step).count();
    _speed = std::clamp(_speed + dice.between(-1, 1) * seconds, _slowest, _fastest);
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

double pathLoss(double metres)
{
    return 128.1 + 37.6 * std::log10(std::max(metres, 35.0) / 1000);
}

} // namespace spectrel
