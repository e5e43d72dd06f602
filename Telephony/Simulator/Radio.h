#pragma once

#include <chrono>
#include <cstdint>
#include <random>
#include <string_view>

namespace spectrel {

/// How the simulated phone moves. Stress: fast, and every record comes at every step.
enum class Scene : std::uint8_t { Still, Walk, Drive, Stress };

/// "still", "walk", "drive", "stress".
bool sceneNamed(std::string_view name, Scene& scene);

/// Random numbers that are the same with every library: a seed's drive is the same everywhere.
class Dice {
public:
    explicit Dice(std::uint32_t seed)
        : _engine(seed)
    {
    }
    /// Evenly spread, both ends included.
    double between(double from, double to);
    /// 0 to count - 1.
    std::uint32_t below(std::uint32_t count)
    {
        return number() % count;
    }
    std::uint32_t number()
    {
        return static_cast<std::uint32_t>(_engine());
    }

private:
    std::mt19937 _engine;
};

/// A phone on its way along a road that is a ring.
class Journey {
public:
    /// Begins at a random place. `length`: of the ring, in metres.
    Journey(Scene scene, double length, Dice& dice);

    void advance(std::chrono::milliseconds step, Dice& dice);
    /// Metres from here to a mast that stands `offset` metres beside the place `position`.
    double distanceTo(double position, double offset) const;
    /// Metres along the road to the place `position`, the shorter way round: positive ahead, negative behind.
    double ahead(double position) const;
    /// Metres a second.
    double speed() const
    {
        return _speed;
    }

private:
    double _length;
    double _slowest; // metres a second
    double _fastest;
    double _position;
    double _speed;
};

/// Shadowing by houses and hills: decibels that wander slowly around 0.
class Shadowing {
public:
    explicit Shadowing(Dice& dice)
        : _decibels(dice.between(-4, 4))
    {
    }
    void advance(std::chrono::milliseconds step, Dice& dice);
    double decibels() const
    {
        return _decibels;
    }

private:
    double _decibels;
};

/// A stretch of the road where hills take up to `loss` dB, in its middle.
struct Valley {
    double from; // metres along the road
    double to;
    double loss;

    double lossAt(const Journey& journey) const;
};

/// Path loss in dB at a distance in metres, not below 35 m (3GPP TR 36.942, 4.5.2: macro cell, urban, 2 GHz:
/// 128.1 + 37.6 lg(d/km)).
double pathLoss(double metres);

} // namespace spectrel
