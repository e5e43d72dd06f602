#pragma once

#include "Values/Moment.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// What a cell radiates; not to be confused with what a baseband is called on the command line (`Technology`).
enum class RadioTechnology : std::uint8_t { GSM, UMTS, LTE, CDMA, EVDO };

/// "gsm", "umts", "lte", "cdma", "evdo".
std::string_view radioTechnologyName(RadioTechnology technology);

/// What is measured of a cell, in dB (RSRQ, EcNo, EcIo, Srxlev, C1, C2) or dBm (RSRP, RSSI, RSCP).
enum class Level : std::uint8_t { RSRP, RSRQ, RSSI, RSCP, EcNo, EcIo, Srxlev, C1, C2 };
inline constexpr std::size_t LevelCount = 9;

/// "RSRP" and so on; the name that alarms and formats use.
std::string_view levelName(Level level);
std::optional<Level> levelNamed(std::string_view name);
/// "dB" or "dBm".
std::string_view levelUnit(Level level);

/// Everything that is known of a cell apart from its technology, in the order in which it is reported.
enum class CellKey : std::uint8_t {
    PLMN,
    Operator,
    Area,
    Cell,
    Site,
    RNC,
    Sector,
    Id,
    Channel,
    Band,
    DownlinkMHz,
    UplinkMHz,
    BandwidthMHz,
    FirstLevel, // the levels follow, each under its own name
    End = FirstLevel + LevelCount
};
inline constexpr std::size_t CellKeyCount = static_cast<std::size_t>(CellKey::End);

/// What cells of the technology are compared by: RSSI, RSCP, RSRP, or EcIo for both kinds of CDMA.
Level strengthLevelOf(RadioTechnology technology);

constexpr CellKey cellKeyOf(Level level)
{
    return static_cast<CellKey>(static_cast<std::size_t>(CellKey::FirstLevel) + static_cast<std::size_t>(level));
}

/// "plmn", "operator", ... "bandwidthMHz", "RSRP", ...
std::string_view cellKeyName(CellKey key);

/// A leaf's path in the display tree, as a number that `PathTable` gives; 0 for none.
using PathNumber = std::uint32_t;

/// Where a value comes from: the leaf that holds it, and when the leaf was last stored (also with an equal value). What
/// is derived from another value (site, band, MHz, operator) has the origin of that one.
struct Origin {
    PathNumber path = 0;
    std::uint64_t message = 0; // its number, counted from 0
    Moment time {};

    explicit operator bool() const
    {
        return path != 0;
    }
};

/// A cell as the display shows it. What is not known is empty: an empty text, or no value.
struct Cell {
    RadioTechnology technology = RadioTechnology::LTE;
    std::string plmn; // "001-01"
    std::string operatorName;
    std::optional<std::uint32_t> area; // TAC (16 bits) or LAC (16 bits)
    std::optional<std::uint32_t> cell; // E-UTRAN (28 bits), UTRAN (16 or 28 bits), GSM CI (16 bits), base station id
    std::optional<std::uint32_t> site; // LTE: eNB identity, the cell identity without its low 8 bits
    std::optional<std::uint32_t> rnc; // UMTS: the upper 12 of 28 bits
    std::optional<std::uint32_t> sector; // LTE: the low 8 bits; UMTS: the low 16 of 28 bits
    std::optional<std::uint32_t> id; // PCI, primary scrambling code, BSIC (NCC × 8 + BCC), PN offset in 64 chips
    std::optional<std::uint32_t> channel; // downlink: EARFCN, UARFCN, ARFCN, CDMA channel
    std::string band; // "3", "DCS 1800"; empty where the channel has several, or the display contradicts it
    std::optional<double> downlinkMHz; // centre frequencies
    std::optional<double> uplinkMHz;
    std::optional<double> bandwidthMHz;
    std::array<std::optional<double>, LevelCount> levels;
    std::array<Origin, CellKeyCount> origins; // by key; none for what is not known
    Moment stored {}; // when an identity or level of it was last stored
    /// Of a serving cell: the first message that showed it. Nothing of it was stored before.
    std::uint64_t sinceMessage = 0;
    Moment since {};

    const std::optional<double>& level(Level which) const
    {
        return levels[static_cast<std::size_t>(which)];
    }
    const Origin& origin(CellKey key) const
    {
        return origins[static_cast<std::size_t>(key)];
    }
    /// What cells of the technology are compared by, where it is known of this one.
    std::optional<Level> strengthLevel() const
    {
        const Level which = strengthLevelOf(technology);
        return level(which) ? std::optional(which) : std::nullopt;
    }
    /// That level; none where it is not known.
    const std::optional<double>& strength() const
    {
        return level(strengthLevelOf(technology));
    }
};

/// Whether both are the same cell as far as both tell: technology, and each of channel, id and cell that both know; at
/// least one of id and cell must be known to both.
bool isSameCell(const Cell& left, const Cell& right);

} // namespace spectrel
