#include "Analysis/Report/Distribution.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

void Distribution::add(double value)
{
    if (std::isnan(value))
        return;
    const double held = std::clamp(value, -Limit, Limit);
    _min = _count == 0 ? held : std::min(_min, held);
    _max = _count == 0 ? held : std::max(_max, held);
    _sum += held;
    ++_count;
    ++_classes[static_cast<int>(std::lround(held / ClassWidth))];
}

std::optional<double> Distribution::min() const
{
    return _count ? std::optional(_min) : std::nullopt;
}

std::optional<double> Distribution::mean() const
{
    return _count ? std::optional(_sum / static_cast<double>(_count)) : std::nullopt;
}

std::optional<double> Distribution::max() const
{
    return _count ? std::optional(_max) : std::nullopt;
}

std::optional<double> Distribution::percentile(double share) const
{
    std::uint64_t below = 0;
    for (const auto& [place, count] : _classes) {
        below += count;
        if (static_cast<double>(below) >= share * static_cast<double>(_count))
            return std::clamp(place * ClassWidth, _min, _max);
    }
    return std::nullopt;
}

} // namespace spectrel
