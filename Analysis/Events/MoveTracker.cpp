#include "Analysis/Events/MoveTracker.h"

#include <utility>

namespace spectrel {

namespace {

using Number = std::optional<std::uint32_t>;

bool isOther(const Number& one, const Number& other)
{
    return one && other && *one != *other;
}

/// A UTRAN cell identity is shown with its network controller (28 bits) or without (16 bits).
bool isOtherCellIdentity(RadioTechnology technology, const Number& one, const Number& other)
{
    constexpr std::uint32_t ShortIdentity = 0xFFFF;
    if (!isOther(one, other))
        return false;
    const bool isShort = *one <= ShortIdentity || *other <= ShortIdentity;
    return technology != RadioTechnology::UMTS || !isShort || ((*one ^ *other) & ShortIdentity) != 0;
}

bool hasIdentity(const Cell& cell)
{
    return cell.channel || cell.id || cell.cell;
}

template <typename Value> void put(Value& into, const Value& value)
{
    into = value;
}

/// Copies one key's value; levels are values of their own.
void copyKey(CellKey key, const Cell& from, Cell& into)
{
    switch (key) {
    case CellKey::PLMN:
        return put(into.plmn, from.plmn);
    case CellKey::Operator:
        return put(into.operatorName, from.operatorName);
    case CellKey::Area:
        return put(into.area, from.area);
    case CellKey::Cell:
        return put(into.cell, from.cell);
    case CellKey::Site:
        return put(into.site, from.site);
    case CellKey::RNC:
        return put(into.rnc, from.rnc);
    case CellKey::Sector:
        return put(into.sector, from.sector);
    case CellKey::Id:
        return put(into.id, from.id);
    case CellKey::Channel:
        return put(into.channel, from.channel);
    case CellKey::Band:
        return put(into.band, from.band);
    case CellKey::DownlinkMHz:
        return put(into.downlinkMHz, from.downlinkMHz);
    case CellKey::UplinkMHz:
        return put(into.uplinkMHz, from.uplinkMHz);
    case CellKey::BandwidthMHz:
        return put(into.bandwidthMHz, from.bandwidthMHz);
    default: // a level
        const auto level = static_cast<std::size_t>(key) - static_cast<std::size_t>(CellKey::FirstLevel);
        return put(into.levels[level], from.levels[level]);
    }
}

enum class KnownLevels : bool { Stay, AreReplaced };

void mergeInto(Cell& into, const Cell& stored, KnownLevels levels)
{
    for (std::size_t index = 0; index < CellKeyCount; ++index) {
        const auto key = static_cast<CellKey>(index);
        if (!stored.origin(key))
            continue;
        if (key >= CellKey::FirstLevel && levels == KnownLevels::Stay && into.origin(key))
            continue;
        copyKey(key, stored, into);
        into.origins[index] = stored.origins[index];
    }
    into.stored = stored.stored;
}

} // namespace

Cell storedBy(const Cell& cell, std::uint64_t message)
{
    Cell stored;
    stored.technology = cell.technology;
    stored.stored = cell.stored;
    for (std::size_t index = 0; index < CellKeyCount; ++index) {
        if (!cell.origins[index] || cell.origins[index].message != message)
            continue;
        copyKey(static_cast<CellKey>(index), cell, stored);
        stored.origins[index] = cell.origins[index];
    }
    return stored;
}

std::vector<std::string_view> differences(const Cell& from, const Cell& to)
{
    std::vector<std::string_view> keys;
    if (from.technology != to.technology)
        keys.emplace_back("technology");
    if (!from.band.empty() && !to.band.empty() && from.band != to.band)
        keys.emplace_back("band");
    if (isOther(from.channel, to.channel))
        keys.emplace_back("channel");
    if (isOther(from.id, to.id))
        keys.emplace_back("id");
    if (isOtherCellIdentity(to.technology, from.cell, to.cell))
        keys.emplace_back("cell");
    return keys;
}

bool MoveTracker::isElsewhere(const Cell& stored) const
{
    if (!hasIdentity(stored))
        return false;
    if (!_current)
        return true;
    return stored.technology != _current->technology || isOther(stored.channel, _current->channel)
        || isOther(stored.id, _current->id) || isOtherCellIdentity(stored.technology, stored.cell, _current->cell);
}

void MoveTracker::begin(const Cell& stored, std::uint64_t n, Moment time, bool isAfterLoss)
{
    std::optional<Cell> from = _move ? _move->from : _current;
    const bool wasLost = isAfterLoss || (_move && _move->isAfterLoss);
    _current = stored;
    _move = CellMove {n, time, std::move(from), stored, wasLost};
    if (_move->from && isSameCell(*_move->from, stored))
        _move.reset(); // back before the other cell had a name
}

void MoveTracker::learn(const Cell& stored)
{
    if (!_current || stored.technology != _current->technology)
        return;
    mergeInto(*_current, stored, KnownLevels::AreReplaced);
    if (_move)
        mergeInto(_move->to, stored, KnownLevels::Stay);
}

CellMove MoveTracker::take()
{
    CellMove move = *std::move(_move);
    _move.reset();
    return move;
}

} // namespace spectrel
