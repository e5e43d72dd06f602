#include "Analysis/ServingTrack.h"

#include <algorithm>

namespace spectrel {

namespace {

bool differs(const std::optional<std::uint32_t>& known, const std::optional<std::uint32_t>& told)
{
    return known && told && *known != *told;
}

} // namespace

void ServingTrack::useTechnology(RadioTechnology technology, Step step)
{
    if (isKnown() && _cell.technology != technology)
        return begin(technology, step);
    _cell.technology = technology; // of a cell of which only the network or the area is known so far
    if (_cell.since == Moment())
        beginAt(step);
}

void ServingTrack::beginAt(Step step)
{
    _cell.sinceMessage = step.message;
    _cell.since = step.time;
}

bool ServingTrack::contradicts(const ReadValue& value) const
{
    const auto told = identityOf(_cell.technology, value.meaning, value.number);
    switch (value.meaning) {
    case Meaning::Channel:
        return differs(_cell.channel, told);
    case Meaning::Id:
        return differs(_cell.id, told);
    case Meaning::Cell:
        return differs(_cell.cell, told);
    default:
        return false;
    }
}

void ServingTrack::begin(RadioTechnology technology, Step step)
{
    _cell = {};
    _cell.technology = technology;
    beginAt(step);
    _cell.stored = step.time;
    _hints.band = _hints.uplinkChannel = std::nullopt;
}

bool ServingTrack::store(const ReadValue& value, std::uint8_t rank)
{
    if (value.meaning == Meaning::BandIndicator || value.meaning == Meaning::UplinkChannel) {
        const bool isBand = value.meaning == Meaning::BandIndicator;
        auto& hint = isBand ? _hints.band : _hints.uplinkChannel;
        const auto told = identityOf(_cell.technology, value.meaning, value.number);
        (isBand ? _bandPath : _uplinkPath) = value.origin.path;
        _isBandStale |= hint != told;
        hint = told;
        return told.has_value();
    }
    if (value.meaning == Meaning::BandwidthMHz) {
        _cell.bandwidthMHz = value.number;
        setOrigin(_cell, CellKey::BandwidthMHz, value.origin);
        return true;
    }
    if (value.meaning == Meaning::Level) {
        auto& known = _ranks[static_cast<std::size_t>(value.level)];
        const Origin& origin = _cell.origin(cellKeyOf(value.level));
        if (origin
            && (origin.message > value.origin.message || (origin.message == value.origin.message && known < rank)))
            return false;
        known = rank;
    }
    const auto cellBefore = _cell.cell;
    const auto channelBefore = _cell.channel;
    if (!storeValue(_cell, value))
        return false;
    _isPartsStale |= cellBefore != _cell.cell;
    _isBandStale |= channelBefore != _cell.channel;
    _cell.stored = std::max(_cell.stored, value.origin.time);
    return true;
}

void ServingTrack::storeNetwork(std::string_view network, const Origin& origin)
{
    _cell.plmn = network;
    setOrigin(_cell, CellKey::PLMN, origin);
    _cell.stored = std::max(_cell.stored, origin.time);
}

void ServingTrack::storeOperator(std::string_view name, const Origin& origin)
{
    _cell.operatorName = name;
    setOrigin(_cell, CellKey::Operator, origin);
}

void ServingTrack::forgetFrom(PathNumber path)
{
    if (path == _bandPath && _hints.band) {
        _hints.band = std::nullopt;
        _isBandStale = true;
    }
    if (path == _uplinkPath && _hints.uplinkChannel) {
        _hints.uplinkChannel = std::nullopt;
        _isBandStale = true;
    }
    for (std::size_t key = 0; key < CellKeyCount; ++key) {
        if (_cell.origins[key].path == path)
            forget(static_cast<CellKey>(key));
    }
}

void ServingTrack::forgetLevels()
{
    for (std::size_t level = 0; level < LevelCount; ++level)
        forgetLevel(static_cast<Level>(level));
}

void ServingTrack::forgetLevel(Level level)
{
    forget(cellKeyOf(level));
}

void ServingTrack::forgetNetwork()
{
    forget(CellKey::PLMN);
    forget(CellKey::Operator);
}

void ServingTrack::forget(CellKey key)
{
    setOrigin(_cell, key, {});
    switch (key) {
    case CellKey::PLMN:
        _cell.plmn.clear();
        break;
    case CellKey::Operator:
        _cell.operatorName.clear();
        break;
    case CellKey::Area:
        _cell.area = std::nullopt;
        break;
    case CellKey::Cell:
        _cell.cell = std::nullopt;
        _isPartsStale = true;
        break;
    case CellKey::Id:
        _cell.id = std::nullopt;
        break;
    case CellKey::Channel:
        _cell.channel = std::nullopt;
        _isBandStale = true;
        break;
    case CellKey::BandwidthMHz:
        _cell.bandwidthMHz = std::nullopt;
        break;
    default:
        if (key >= CellKey::FirstLevel)
            _cell.levels[static_cast<std::size_t>(key) - static_cast<std::size_t>(CellKey::FirstLevel)] = std::nullopt;
    }
}

void ServingTrack::finish()
{
    if (_isPartsStale)
        deriveParts(_cell);
    if (_isBandStale)
        deriveBand(_cell, _hints);
    _isPartsStale = _isBandStale = false;
}

} // namespace spectrel
