#pragma once

#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"

#include <chrono>

namespace spectrel {

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

/// A place far from a mast, over open water, where its cell is heard much too well, in the scene of that name.
struct OpenWater {
    double from; // metres along the road
    double to;

    /// What the far cell gains, in dB.
    double gainAt(const Journey& journey) const;
};

/// Path loss in dB at a distance in metres, not below 35 m (3GPP TR 36.942, 4.5.2: macro cell, urban, 2 GHz:
/// 128.1 + 37.6 lg(d/km)).
double pathLoss(double metres);

} // namespace spectrel
