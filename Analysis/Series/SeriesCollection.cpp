#include "Analysis/Series/SeriesCollection.h"

#include "Analysis/Series/DisplayNumbers.h"

#include <algorithm>
#include <string>
#include <utility>

namespace spectrel {

namespace {

// Lists that are filled anew have new places each time.
constexpr std::size_t MostKnownPlaces = 1024;
constexpr std::size_t MostKnownLeaves = 4096;
constexpr std::size_t LongestName = 192; // of a series, in bytes
constexpr std::chrono::seconds LongestStay {10}; // between two refreshes that count as one stay

constexpr std::size_t CellSize = sizeof(ServedCell) + 128; // with its texts
static_assert(SeriesCollection::MostSeries * Series::LargestSize
            + SeriesCollection::MostCellStatistics * sizeof(Statistics) + SeriesCollection::MostCells * CellSize
            + SeriesCollection::MostMoves * sizeof(SeriesCollection::Move)
        <= SeriesCollection::LargestSize - 1024 * 1024, // what is left is for the places looked at
    "a series collection has its limit");

} // namespace

SeriesCollection::SeriesCollection(DisplayState& display, Analysis& analysis)
    : _display(display)
    , _analysis(analysis)
{
    _display.addReader(*this);
    _analysis.addListener(*this);
}

SeriesCollection::~SeriesCollection()
{
    _analysis.removeListener(*this);
    _display.removeReader(*this);
}

void SeriesCollection::messageApplied(const AppliedMessage&, const Journal& journal)
{
    for (const Journal::Change& change : journal.changes()) {
        if (change.kind != Journal::Kind::StoredAgain)
            noteChange(change, journal);
    }
}

void SeriesCollection::noteChange(const Journal::Change& change, const Journal& journal)
{
    std::optional<double> number;
    if (change.kind == Journal::Kind::Stored)
        number = displayNumber(journal.valueOf(change));
    if (Entry* const known = entryOf(change, journal, number.has_value()))
        known->now = number;
}

/// Null for a leaf that has shown no number yet, or that there is no room for.
SeriesCollection::Entry* SeriesCollection::entryOf(const Journal::Change& change, const Journal& journal, bool isNumber)
{
    if (!change.place)
        return nullptr;
    auto place = _places.find(change.place.get());
    if (place == _places.end()) {
        if (_places.size() >= MostKnownPlaces || _knownLeaves >= MostKnownLeaves) {
            _places.clear();
            _knownLeaves = 0;
        }
        place = _places.emplace(change.place.get(), KnownPlace {change.place, {}}).first;
    }
    auto& leaves = place->second.leaves;
    std::string key(journal.keyOf(change));
    const auto known = leaves.find(key);
    if (known != leaves.end() && (known->second || !isNumber))
        return known->second;
    const std::string path = journal.pathOf(change);
    const auto named = _byName.find(path);
    Entry* const found = named != _byName.end() ? named->second : isNumber ? entry(path) : nullptr;
    if (known != leaves.end()) {
        known->second = found;
    } else if (key.size() <= LongestName && _knownLeaves < MostKnownLeaves) {
        leaves.emplace(std::move(key), found);
        ++_knownLeaves;
    }
    return found;
}

SeriesCollection::Entry* SeriesCollection::entry(std::string_view name)
{
    if (const auto known = _byName.find(name); known != _byName.end())
        return known->second;
    if (_entries.size() >= MostSeries || name.size() > LongestName) {
        ++_dropped;
        return nullptr;
    }
    Entry& added = _entries.emplace_back();
    added.name = name;
    _byName.emplace(added.name, &added);
    return &added;
}

void SeriesCollection::setNow(std::string_view name, std::optional<double> value)
{
    if (Entry* const known = entry(name))
        known->now = value;
}

void SeriesCollection::refreshed(const CellReport& report, const Analysis&)
{
    const Moment before = _axis.now();
    const int joins = _axis.advance(report.time);
    const Cell* const serving = report.serving ? &*report.serving : nullptr;
    for (std::size_t level = 0; level < LevelCount; ++level) {
        const std::string_view name = levelName(static_cast<Level>(level));
        const auto value = serving ? serving->levels[level] : std::nullopt;
        if (value || _byName.contains(name))
            setNow(name, value);
    }
    for (Entry& each : _entries) {
        if (each.name.find("Kbps ") != std::string::npos && !each.name.starts_with('/'))
            each.now.reset(); // unless the context is still there
    }
    for (const DataContext& context : report.contexts) {
        if (context.downlinkKbps)
            setNow("downlinkKbps " + context.name, context.downlinkKbps);
        if (context.uplinkKbps)
            setNow("uplinkKbps " + context.name, context.uplinkKbps);
    }
    for (Entry& each : _entries)
        each.series.add(_axis, joins, each.now);
    noteCell(serving, before);
}

void SeriesCollection::noteCell(const Cell* serving, Moment before)
{
    const std::uint32_t place = serving ? placeOf(*serving) : NoCell;
    const Moment now = _axis.now();
    if (place != _serving && _moves.size() < MostMoves)
        _moves.push_back({now, place});
    else if (place != _serving)
        ++_dropped;
    if (place != NoCell) {
        ServedCell& served = _cells[place];
        if (place == _serving && now - before <= LongestStay)
            served.served += now - before;
        served.cell = *serving;
        served.last = now;
        noteLevels(served, *serving);
    }
    _serving = place;
}

std::uint32_t SeriesCollection::placeOf(const Cell& cell)
{
    if (_serving != NoCell && isSameCell(_cells[_serving].cell, cell))
        return _serving;
    const auto known =
        std::ranges::find_if(_cells, [&cell](const ServedCell& served) { return isSameCell(served.cell, cell); });
    if (known != _cells.end())
        return static_cast<std::uint32_t>(known - _cells.begin());
    if (_cells.size() >= MostCells) {
        ++_dropped;
        return NoCell;
    }
    ServedCell& added = _cells.emplace_back();
    added.first = _axis.now();
    return static_cast<std::uint32_t>(_cells.size() - 1);
}

void SeriesCollection::noteLevels(ServedCell& served, const Cell& cell)
{
    for (std::size_t level = 0; level < LevelCount; ++level) {
        if (!cell.levels[level])
            continue;
        auto& statistics = served.levels[level];
        if (!statistics && _cellStatistics < MostCellStatistics) {
            statistics = std::make_unique<Statistics>();
            ++_cellStatistics;
        }
        if (statistics)
            statistics->add(*cell.levels[level]);
    }
}

const Series* SeriesCollection::find(std::string_view name) const
{
    const auto known = _byName.find(name);
    return known == _byName.end() ? nullptr : &known->second->series;
}

std::vector<std::string_view> SeriesCollection::names() const
{
    std::vector<std::string_view> names;
    for (const Entry& each : _entries)
        names.emplace_back(each.name);
    return names;
}

} // namespace spectrel
