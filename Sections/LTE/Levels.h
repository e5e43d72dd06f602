#pragma once

#include "LogGenerator/Template/Fields.h"

#include <cstdint>
#include <string_view>

/// How the LTE records count levels: in steps from a lowest value.
namespace spectrel {

enum class LevelUnit : std::uint8_t { dB, dBm };

/// A level in decibels: `raw` steps of 1/StepsPerDecibel above Lowest.
template <int StepsPerDecibel, int Lowest> constexpr double level(std::uint32_t raw)
{
    return static_cast<double>(raw) / StepsPerDecibel + Lowest;
}

constexpr std::string_view nameOf(LevelUnit unit)
{
    return unit == LevelUnit::dB ? " dB" : " dBm";
}

/// "%4.2f dB" or "%4.2f dBm".
template <int StepsPerDecibel, int Lowest, LevelUnit Unit>
std::string_view fineLevel(std::uint32_t raw, TextBuffer& buffer)
{
    return buffer.fixed2(level<StepsPerDecibel, Lowest>(raw)).text(nameOf(Unit)).view();
}

/// "%d dB" or "%d dBm", of steps that are `DecibelsPerStep` each.
template <int DecibelsPerStep, int Lowest, LevelUnit Unit>
std::string_view wholeLevel(std::uint32_t raw, TextBuffer& buffer)
{
    return buffer.decimal(static_cast<std::int64_t>(raw) * DecibelsPerStep + Lowest).text(nameOf(Unit)).view();
}

/// As `wholeLevel`, but "Not Present" for one raw value.
template <std::uint32_t NotPresent, int DecibelsPerStep, int Lowest, LevelUnit Unit>
std::string_view optionalLevel(std::uint32_t raw, TextBuffer& buffer)
{
    return raw == NotPresent ? "Not Present" : wholeLevel<DecibelsPerStep, Lowest, Unit>(raw, buffer);
}

/// The lowest level a cell must be received at; broadcast in steps of 2 dB.
constexpr Formatter Qrxlevmin = wholeLevel<2, -140, LevelUnit::dBm>;
/// The cell-selection receive level.
constexpr Formatter Srxlev = wholeLevel<1, -30, LevelUnit::dBm>;

} // namespace spectrel
