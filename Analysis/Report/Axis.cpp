#include "Analysis/Report/Axis.h"

#include <array>
#include <cmath>

namespace spectrel {

LevelAxis LevelAxis::around(double min, double max)
{
    constexpr std::array<double, 7> Steps {1, 2, 5, 10, 20, 50, 100};
    constexpr double Lines = 6;
    double step = Steps.back();
    for (const double candidate : Steps) {
        if ((max - min) / candidate <= Lines) {
            step = candidate;
            break;
        }
    }
    LevelAxis axis {std::floor(min / step) * step, std::ceil(max / step) * step, {}};
    if (axis.high - axis.low < step)
        axis.high = axis.low + step;
    for (double line = axis.low; line <= axis.high + step / 2; line += step)
        axis.lines.push_back(line);
    return axis;
}

std::vector<Moment> timeLines(Moment first, std::chrono::microseconds length)
{
    using std::chrono::seconds;
    constexpr std::array<int, 18> Steps {
        1, 2, 5, 10, 15, 30, 60, 120, 300, 600, 900, 1800, 3600, 7200, 10800, 21600, 43200, 86400};
    constexpr int Lines = 8;
    seconds step(Steps.back());
    for (const int candidate : Steps) {
        if (length / seconds(candidate) < Lines) {
            step = seconds(candidate);
            break;
        }
    }
    while (length / step >= Lines)
        step *= 2;
    std::vector<Moment> lines;
    const auto since = std::chrono::floor<seconds>(first).time_since_epoch();
    for (Moment line {since / step * step}; line <= first + length; line += step) {
        if (line >= first)
            lines.push_back(line);
    }
    return lines;
}

} // namespace spectrel
