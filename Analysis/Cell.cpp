#include "Analysis/Cell.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr std::array<std::string_view, 5> TechnologyNames {"gsm", "umts", "lte", "cdma", "evdo"};

constexpr std::array<std::string_view, LevelCount> LevelNames {
    "RSRP", "RSRQ", "RSSI", "RSCP", "EcNo", "EcIo", "Srxlev", "C1", "C2"};

constexpr std::array<std::string_view, static_cast<std::size_t>(CellKey::FirstLevel)> KeyNames {"plmn", "operator",
    "area", "cell", "site", "rnc", "sector", "id", "channel", "band", "downlinkMHz", "uplinkMHz", "bandwidthMHz"};

/// What cells of a technology are compared by.
constexpr std::array<Level, 5> Strengths {Level::RSSI, Level::RSCP, Level::RSRP, Level::EcIo, Level::EcIo};

/// Whether two values contradict each other; what is not known does not.
bool contradicts(const std::optional<std::uint32_t>& left, const std::optional<std::uint32_t>& right)
{
    return left && right && *left != *right;
}

} // namespace

std::string_view radioTechnologyName(RadioTechnology technology)
{
    return TechnologyNames[static_cast<std::size_t>(technology)];
}

std::string_view levelName(Level level)
{
    return LevelNames[static_cast<std::size_t>(level)];
}

std::optional<Level> levelNamed(std::string_view name)
{
    const auto found = std::ranges::find(LevelNames, name);
    if (found == LevelNames.end())
        return std::nullopt;
    return static_cast<Level>(found - LevelNames.begin());
}

std::string_view levelUnit(Level level)
{
    const bool isPower = level == Level::RSRP || level == Level::RSSI || level == Level::RSCP;
    return isPower ? "dBm" : "dB";
}

std::string_view cellKeyName(CellKey key)
{
    const auto position = static_cast<std::size_t>(key);
    return position < KeyNames.size() ? KeyNames[position] : LevelNames[position - KeyNames.size()];
}

Level strengthLevelOf(RadioTechnology technology)
{
    return Strengths[static_cast<std::size_t>(technology)];
}

bool isSameCell(const Cell& left, const Cell& right)
{
    if (left.technology != right.technology)
        return false;
    const bool isComparable = (left.id && right.id) || (left.cell && right.cell);
    return isComparable && !contradicts(left.channel, right.channel) && !contradicts(left.id, right.id)
        && !contradicts(left.cell, right.cell);
}

} // namespace spectrel
