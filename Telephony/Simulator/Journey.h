#pragma once

#include "Telephony/Simulator/Dice.h"

#include <chrono>
#include <cstdint>
#include <string_view>

namespace spectrel {

/// How the simulated phone moves. Stress: fast, and every record comes at every step.
enum class Scene : std::uint8_t { Still, Walk, Drive, Stress };

/// "still", "walk", "drive", "stress".
bool sceneNamed(std::string_view name, Scene& scene);

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
    double _minSpeed; // metres a second
    double _maxSpeed;
    double _position;
    double _speed;
};

} // namespace spectrel
