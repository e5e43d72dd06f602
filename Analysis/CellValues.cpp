#include "Analysis/CellValues.h"

#include <array>
#include <cmath>

namespace spectrel {

namespace {

struct Range {
    double min;
    double max;
};

/// What the radio can measure at all; what is beyond comes of bytes that were no level. dB or dBm.
constexpr std::array<Range, LevelCount> LevelRanges {{
    {-156, -31}, // RSRP (3GPP TS 36.133, 9.1.4)
    {-43, 20}, // RSRQ (9.1.7 and extensions)
    {-140, 0}, // RSSI
    {-140, -10}, // RSCP
    {-50, 0}, // EcNo
    {-50, 0}, // EcIo
    {-200, 200}, // Srxlev
    {-200, 200}, // C1
    {-200, 300}, // C2: C1 with an offset of up to 126 dB
}};

/// Of each technology, in its order: GSM, UMTS, LTE, CDMA, EV-DO.
constexpr std::array<Range, 5> CellRanges {
    {{0, 0xFFFF}, {0, 0xFFFFFFF}, {0, 0xFFFFFFF}, {1, 0xFFFF}, {1, 0xFFFF}}}; // a record without one shows 0 for CDMA
constexpr std::array<Range, 5> IdRanges {{{0, 63}, {0, 511}, {0, 503}, {0, 511}, {0, 511}}};
constexpr std::array<Range, 5> ChannelRanges {{{0, 1023}, {1, 16383}, {0, 262143}, {0, 2047}, {0, 2047}}};
/// 0, 0xFFFE and 0xFFFF are no areas (3GPP TS 23.003, 4.1 and 19.4.2.3).
constexpr Range AreaRange {1, 0xFFFD};
constexpr Range BandRange {0, 255};

Range rangeOf(RadioTechnology technology, Meaning meaning)
{
    const auto index = static_cast<std::size_t>(technology);
    switch (meaning) {
    case Meaning::Cell:
        return CellRanges[index];
    case Meaning::Id:
        return IdRanges[index];
    case Meaning::Channel:
    case Meaning::UplinkChannel:
        return ChannelRanges[index];
    case Meaning::Area:
        return AreaRange;
    default:
        return BandRange;
    }
}

ChannelNumbering numberingOf(RadioTechnology technology, ChannelNumbering umts)
{
    switch (technology) {
    case RadioTechnology::GSM:
        return ChannelNumbering::GSM;
    case RadioTechnology::UMTS:
        return umts;
    case RadioTechnology::LTE:
        return ChannelNumbering::EUTRA;
    default:
        return ChannelNumbering::CDMA;
    }
}

/// GSM's indicator only parts the numbers that DCS 1800 and PCS 1900 share.
DownlinkChannel findGSMChannel(std::uint32_t channel, const std::optional<std::uint32_t>& indicator)
{
    constexpr std::uint32_t FirstShared = 512;
    constexpr std::uint32_t LastOf1800 = 885;
    if (!indicator || channel < FirstShared || channel > LastOf1800)
        return findDownlinkChannel(ChannelNumbering::GSM, channel);
    return findDownlinkChannel(ChannelNumbering::GSM, channel, *indicator == 0 ? "DCS 1800" : "PCS 1900");
}

DownlinkChannel findChannel(const Cell& cell, const BandHints& hints)
{
    if (cell.technology == RadioTechnology::GSM)
        return findGSMChannel(*cell.channel, hints.band);
    const ChannelNumbering numbering = numberingOf(cell.technology, hints.umtsNumbering);
    if (!hints.band)
        return findDownlinkChannel(numbering, *cell.channel);
    return findDownlinkChannel(numbering, *cell.channel, std::to_string(*hints.band));
}

/// The uplink that the cell names; none where its band does not have it.
std::optional<double> uplinkNamed(const Cell& cell, const BandHints& hints)
{
    const ChannelNumbering numbering = numberingOf(cell.technology, hints.umtsNumbering);
    if (!hints.uplinkChannel || cell.band.empty()
        || (numbering != ChannelNumbering::EUTRA && numbering != ChannelNumbering::UTRAFDD))
        return std::nullopt;
    for (const BandChannel& channel : bandsOfChannel(numbering, *hints.uplinkChannel, cell.band)) {
        if (channel.direction != ChannelDirection::Downlink)
            return channel.uplinkMHz;
    }
    return std::nullopt;
}

void storeNumber(
    Cell& cell, CellKey key, std::optional<std::uint32_t>& into, std::uint32_t number, const Origin& origin)
{
    into = number;
    setOrigin(cell, key, origin);
}

} // namespace

std::optional<std::uint32_t> identityOf(RadioTechnology technology, Meaning meaning, double number)
{
    const auto [min, max] = rangeOf(technology, meaning);
    if (number < min || number > max || number != std::floor(number))
        return std::nullopt;
    return static_cast<std::uint32_t>(number);
}

bool isPossible(Level level, double number)
{
    const auto [min, max] = LevelRanges[static_cast<std::size_t>(level)];
    return number >= min && number <= max;
}

void setOrigin(Cell& cell, CellKey key, const Origin& origin)
{
    cell.origins[static_cast<std::size_t>(key)] = origin;
}

void deriveParts(Cell& cell)
{
    cell.site = cell.rnc = cell.sector = std::nullopt;
    if (!cell.cell)
        return;
    const Origin& origin = cell.origin(CellKey::Cell);
    if (cell.technology == RadioTechnology::LTE) {
        storeNumber(cell, CellKey::Site, cell.site, *cell.cell >> 8, origin);
        storeNumber(cell, CellKey::Sector, cell.sector, *cell.cell & 0xFF, origin);
    } else if (cell.technology == RadioTechnology::UMTS && *cell.cell > 0xFFFF) {
        storeNumber(cell, CellKey::RNC, cell.rnc, *cell.cell >> 16, origin);
        storeNumber(cell, CellKey::Sector, cell.sector, *cell.cell & 0xFFFF, origin);
    }
}

void deriveBand(Cell& cell, const BandHints& hints)
{
    cell.band.clear();
    cell.downlinkMHz = cell.uplinkMHz = std::nullopt;
    if (!cell.channel)
        return;
    const DownlinkChannel found = findChannel(cell, hints);
    const Origin& origin = cell.origin(CellKey::Channel);
    cell.band = found.band;
    cell.downlinkMHz = found.downlinkMHz;
    cell.uplinkMHz = uplinkNamed(cell, hints);
    if (!cell.uplinkMHz)
        cell.uplinkMHz = found.uplinkMHz;
    for (const CellKey key : {CellKey::Band, CellKey::DownlinkMHz, CellKey::UplinkMHz})
        setOrigin(cell, key, origin);
}

bool storeValue(Cell& cell, const ReadValue& value)
{
    if (value.meaning == Meaning::Level) {
        if (!isPossible(value.level, value.number))
            return false;
        cell.levels[static_cast<std::size_t>(value.level)] = value.number;
        setOrigin(cell, cellKeyOf(value.level), value.origin);
        return true;
    }
    const auto identity = identityOf(cell.technology, value.meaning, value.number);
    if (!identity)
        return false;
    switch (value.meaning) {
    case Meaning::Area:
        storeNumber(cell, CellKey::Area, cell.area, *identity, value.origin);
        return true;
    case Meaning::Cell:
        storeNumber(cell, CellKey::Cell, cell.cell, *identity, value.origin);
        return true;
    case Meaning::Id:
        storeNumber(cell, CellKey::Id, cell.id, *identity, value.origin);
        return true;
    case Meaning::Channel:
        storeNumber(cell, CellKey::Channel, cell.channel, *identity, value.origin);
        return true;
    default:
        return false;
    }
}

} // namespace spectrel
