#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Series/Series.h"
#include "Monitor/DisplayState.h"

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace spectrel {

/// A cell that served, with the statistics of its levels over the refreshes at which it did.
struct ServedCell {
    Cell cell; // as it was last
    Moment first {};
    Moment last {};
    std::chrono::microseconds served {0}; // between refreshes at both of which it served
    std::array<std::unique_ptr<Statistics>, LevelCount> levels; // null for one that it never had

    const Statistics* level(Level which) const
    {
        return levels[static_cast<std::size_t>(which)].get();
    }
};

/// Every number of the display and of the cells as a series over time, live and offline alike, in at most 32 MiB
/// whatever comes and however long it goes on.
///
/// A series is named after the path of the leaf ("/Serving Cell Info/UARFCN"), after a level of the serving cell
/// ("RSRP"), or after a context's rate ("downlinkKbps internet.test"). Beyond the largest number of series, cells or
/// moves further ones are not kept, but counted.
class SeriesCollection final : private JournalReader, private AnalysisListener {
public:
    static constexpr std::size_t LargestSize = 32 * 1024 * 1024; // bytes
    static constexpr std::size_t MostSeries = 880;
    static constexpr std::size_t MostCells = 1024;
    static constexpr std::size_t MostCellStatistics = 2560; // of all cells together
    static constexpr std::size_t MostMoves = 16384;

    /// From now on; both outlive this. The analysis' refreshes are the moments of the series.
    SeriesCollection(DisplayState& display, Analysis& analysis);
    ~SeriesCollection() override;
    SeriesCollection(const SeriesCollection&) = delete;
    SeriesCollection& operator=(const SeriesCollection&) = delete;

    const SeriesAxis& axis() const
    {
        return _axis;
    }
    /// Null when there is none of the name.
    const Series* find(std::string_view name) const;
    const Series* level(Level which) const
    {
        return find(levelName(which));
    }
    /// In the order in which they were first seen.
    std::vector<std::string_view> names() const;

    /// In the order in which they first served.
    const std::vector<ServedCell>& cells() const
    {
        return _cells;
    }
    /// From this refresh on the cell served; no cell served from then on where it is `NoCell`.
    struct Move {
        Moment time;
        std::uint32_t cell; // its place among the cells
    };
    static constexpr std::uint32_t NoCell = 0xFFFFFFFF;
    const std::vector<Move>& moves() const
    {
        return _moves;
    }
    /// Series, cells and moves that there was no room for; a name counts each time it comes.
    std::uint64_t dropped() const
    {
        return _dropped;
    }

private:
    struct Entry {
        std::string name;
        Series series;
        std::optional<double> now; // of a leaf: what it shows
    };
    /// The leaves of a container, by their keys, as long as it stands at its place.
    struct KnownPlace {
        Journal::PlaceRef place; // so that no other has its address
        std::unordered_map<std::string, Entry*> leaves; // null: no number so far, or no room
    };

    void messageApplied(const AppliedMessage& message, const Journal& journal) override;
    void messageAnalysed(const AppliedMessage&, const Journal&, const Analysis&, const AnalysedChanges&) override { }
    void refreshed(const CellReport& report, const Analysis& analysis) override;

    void noteChange(const Journal::Change& change, const Journal& journal);
    Entry* entryOf(const Journal::Change& change, const Journal& journal, bool isNumber);
    Entry* entry(std::string_view name);
    void setNow(std::string_view name, std::optional<double> value);
    void noteCell(const Cell* serving, Moment before);
    std::uint32_t placeOf(const Cell& cell);
    void noteLevels(ServedCell& served, const Cell& cell);

    DisplayState& _display;
    Analysis& _analysis;
    SeriesAxis _axis;
    std::deque<Entry> _entries; // where they stay
    std::unordered_map<std::string_view, Entry*> _byName;
    std::unordered_map<const Journal::Place*, KnownPlace> _places;
    std::size_t _knownLeaves = 0; // of all places
    std::vector<ServedCell> _cells;
    std::size_t _cellStatistics = 0;
    std::vector<Move> _moves;
    std::uint32_t _serving = NoCell;
    std::uint64_t _dropped = 0;
};

} // namespace spectrel
