#pragma once

#include "Values/Moment.h"

#include <chrono>
#include <vector>

namespace spectrel {

/// The ends of a scale of levels and the lines between them, on round numbers.
struct LevelAxis {
    double low = 0;
    double high = 1;
    std::vector<double> lines; // from low to high

    /// A scale with both values; about six lines.
    static LevelAxis around(double min, double max);
};

/// Moments on the round: at most eight within the time, a second, minute, hour or day apart, or a round number of them.
std::vector<Moment> timeLines(Moment first, std::chrono::microseconds length);

} // namespace spectrel
