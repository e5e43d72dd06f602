#pragma once

#include <cstdint>
#include <random>

namespace spectrel {

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

} // namespace spectrel
