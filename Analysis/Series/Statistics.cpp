#include "Analysis/Series/Statistics.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

namespace {

constexpr double LargestValue = 1e30;
constexpr double LargestNumber = 1e15; // of a class; those below are exact

/// Half of a class number, rounded down.
std::int64_t half(std::int64_t number)
{
    return (number - (number < 0 ? 1 : 0)) / 2;
}

} // namespace

void Statistics::add(double value)
{
    if (!(std::abs(value) <= LargestValue)) // nor is a not-a-number
        return;
    makeRoomFor(value);
    _min = _count == 0 ? value : std::min(_min, value);
    _max = _count == 0 ? value : std::max(_max, value);
    ++_count;
    _mean += (value - _mean) / static_cast<double>(_count);
    ++_classes[static_cast<std::size_t>(classNumber(value) - _first)];
}

std::int64_t Statistics::classNumber(double value) const
{
    return std::llround(std::floor(value / _width));
}

/// Doubles the width until the values so far and the new one fit, and moves the classes to where they do.
void Statistics::makeRoomFor(double value)
{
    const double lowest = _count == 0 ? value : std::min(_min, value);
    const double highest = _count == 0 ? value : std::max(_max, value);
    const auto fits = [&] {
        const double largest = std::max(std::abs(lowest), std::abs(highest));
        return largest / _width < LargestNumber && std::floor(highest / _width) - std::floor(lowest / _width) < Classes;
    };
    while (!fits())
        widen();
    const std::int64_t low = classNumber(lowest);
    const std::int64_t high = classNumber(highest);
    constexpr auto Count = static_cast<std::int64_t>(Classes);
    if (_count == 0 || low < _first || high >= _first + Count)
        moveTo(low - (Count - 1 - (high - low)) / 2);
}

void Statistics::widen()
{
    const std::int64_t first = half(_first);
    std::array<std::uint32_t, Classes> classes {};
    for (std::size_t i = 0; i < Classes; ++i)
        classes[static_cast<std::size_t>(half(_first + static_cast<std::int64_t>(i)) - first)] += _classes[i];
    _classes = classes;
    _first = first;
    _width *= 2;
}

/// What holds a value stays within the classes.
void Statistics::moveTo(std::int64_t first)
{
    std::array<std::uint32_t, Classes> classes {};
    for (std::size_t i = 0; i < Classes; ++i) {
        if (_classes[i] != 0)
            classes[static_cast<std::size_t>(_first + static_cast<std::int64_t>(i) - first)] = _classes[i];
    }
    _classes = classes;
    _first = first;
}

double Statistics::percentile(double part) const
{
    const double rank = std::clamp(part, 0.0, 1.0) * static_cast<double>(_count);
    double below = 0;
    for (const Class& each : distribution()) {
        below += each.count;
        if (below >= rank && below > 0)
            return std::clamp(each.from, _min, _max);
    }
    return _max;
}

std::vector<Statistics::Class> Statistics::distribution() const
{
    std::vector<Class> held;
    if (_count == 0)
        return held;
    for (std::int64_t number = classNumber(_min); number <= classNumber(_max); ++number)
        held.push_back({static_cast<double>(number) * _width, _classes[static_cast<std::size_t>(number - _first)]});
    return held;
}

} // namespace spectrel
