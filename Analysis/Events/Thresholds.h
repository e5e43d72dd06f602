#pragma once

#include "Values/Result.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace spectrel {

/// What findings depend on, each with its name on the command line.
enum class Threshold : std::uint8_t {
    PingPongTime,
    BetterNeighbourMargin,
    BetterNeighbourTime,
    HoleTime,
    HoleSrxlev,
    HoleC1,
    HoleEcNo,
    PollutionCells,
    PollutionRange,
    PollutionTime,
    OvershootSites,
    OvershootTime,
    MissingNeighbourMargin,
    MissingNeighbourTime,
    NoServiceTime,
    ReturnTime,
};
inline constexpr std::size_t ThresholdCount = 16;

struct ThresholdRow {
    Threshold threshold;
    std::string_view name;
    double value; // unless another is set
    double min;
    double max;
    std::string_view meaning;
};

/// One row a threshold, in the order of `Threshold`.
inline constexpr std::array<ThresholdRow, ThresholdCount> ThresholdTable {{
    {Threshold::PingPongTime, "ping-pong-time", 10, 0.1, 3600, "s from leaving a cell to being back on it"},
    {Threshold::BetterNeighbourMargin, "better-neighbour-margin", 6, 0, 60, "dB over the serving cell"},
    {Threshold::BetterNeighbourTime, "better-neighbour-time", 10, 0, 3600, "s without moving to it"},
    {Threshold::HoleTime, "hole-time", 4, 0, 3600, "s below the cell's minimum"},
    {Threshold::HoleSrxlev, "hole-srxlev", 0, -50, 50, "dB of Srxlev, below which an LTE cell is too weak"},
    {Threshold::HoleC1, "hole-c1", 0, -50, 50, "dB of C1, below which a GSM cell is too weak"},
    {Threshold::HoleEcNo, "hole-ecno", -18, -30, 0, "dB of Ec/No, below which a UMTS cell is too weak"},
    {Threshold::PollutionCells, "pollution-cells", 3, 1, 32, "neighbours on the serving cell's channel"},
    {Threshold::PollutionRange, "pollution-range", 5, 0, 30, "dB below the serving cell within which they are"},
    {Threshold::PollutionTime, "pollution-time", 4, 0, 3600, "s of it"},
    {Threshold::OvershootSites, "overshoot-sites", 3, 1, 32, "other cells that served since the cell did"},
    {Threshold::OvershootTime, "overshoot-time", 120, 1, 3600, "s since the cell was left"},
    {Threshold::MissingNeighbourMargin, "missing-neighbour-margin", -3, -60, 60,
        "dB over the strongest listed cell of a cell that is not listed"},
    {Threshold::MissingNeighbourTime, "missing-neighbour-time", 3, 0, 3600, "s of it"},
    {Threshold::NoServiceTime, "no-service-time", 30, 0, 86400, "s without service"},
    {Threshold::ReturnTime, "return-time", 60, 0, 86400, "s on an older system until the phone is back"},
}};

/// The thresholds of one run.
class Thresholds {
public:
    constexpr Thresholds()
    {
        for (std::size_t row = 0; row < ThresholdCount; ++row)
            _values[row] = ThresholdTable[row].value;
    }
    double operator[](Threshold threshold) const
    {
        return _values[static_cast<std::size_t>(threshold)];
    }
    /// From "NAME=VALUE", such as "ping-pong-time=20".
    Outcome set(std::string_view assignment);

private:
    std::array<double, ThresholdCount> _values {};
};

} // namespace spectrel
