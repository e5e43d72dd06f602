#pragma once

#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Scene.h"

#include <chrono>
#include <optional>

namespace spectrel {

/// A phone on its way along a road that is a ring.
class Journey {
public:
    /// Metres of the road that the worlds share in the scene of that name.
    static constexpr double SharedLength = 6000;

    /// Begins at a random place. `length`: of the ring, in metres. In the scene of that name, phones of the same seed
    /// and length are at the same place at any time, whatever else the dice are thrown for.
    Journey(Scene scene, double length, Dice& dice);

    /// Goes to and fro from now on, as far as `reach` metres from the place `centre`.
    void stayAround(double centre, double reach);
    void advance(std::chrono::milliseconds step, Dice& dice);
    /// Metres from here to a mast that stands `offset` metres beside the place `position`.
    double distanceTo(double position, double offset) const;
    /// Metres along the road to the place `position`, the shorter way round: positive ahead, negative behind.
    double ahead(double position) const;
    /// What tunnels take from every signal here, in dB.
    double tunnelLoss() const;
    Scene scene() const
    {
        return _scene;
    }
    /// Metres a second.
    double speed() const
    {
        return _speed;
    }

private:
    struct Turning {
        double centre;
        double reach;
    };

    Scene _scene;
    double _length;
    Pace _pace;
    double _position;
    double _speed;
    int _direction = 1;
    std::optional<Turning> _turning;
    std::optional<Dice> _ownDice;
};

} // namespace spectrel
