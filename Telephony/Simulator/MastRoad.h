#pragma once

#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/Propagation.h"

#include <chrono>
#include <cstddef>
#include <vector>

namespace spectrel {

/// A phone on a ring road past masts, each behind its own houses and hills.
class MastRoad {
public:
    /// `spacing`: metres between two masts, more or less.
    MastRoad(Scene scene, std::size_t masts, double spacing, Dice& dice);

    void advance(std::chrono::milliseconds step, Dice& dice);

    std::size_t masts() const
    {
        return _masts.size();
    }
    /// What is lost between the mast and the phone, in dB.
    double loss(std::size_t mast) const;
    /// Metres to the mast.
    double distance(std::size_t mast) const;

private:
    struct Mast {
        double position; // metres along the road
        double offset; // metres beside it
        Shadowing shadowing;
    };

    Journey _journey;
    OpenWater _water; // in front of the first mast
    std::vector<Mast> _masts;
};

} // namespace spectrel
