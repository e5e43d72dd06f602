#pragma once

#include "Analysis/CellValues.h"

#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// A serving cell put together from the records that speak of it.
///
/// A record that names another cell (technology, channel, id or cell identity differ from what is known) begins a new
/// one: nothing of the cell before stays.
class ServingTrack {
public:
    struct Step {
        std::uint64_t message = 0;
        Moment time {};
    };

    explicit ServingTrack(ChannelNumbering umtsNumbering = ChannelNumbering::UTRAFDD)
    {
        _hints.umtsNumbering = umtsNumbering;
    }

    const Cell& cell() const
    {
        return _cell;
    }
    /// Whether anything tells which cell it is.
    bool isKnown() const
    {
        return _cell.id || _cell.cell || _cell.channel;
    }

    /// A message says something of a cell of the technology.
    void useTechnology(RadioTechnology technology, Step step);
    /// Whether the value belongs to another cell than the one known.
    bool contradicts(const ReadValue& value) const;
    /// Forgets the cell; the next values are those of another one.
    void begin(RadioTechnology technology, Step step);
    /// The cell was first told by an earlier message than it seemed.
    void beginAt(Step step);
    /// False for a value out of range. A level with a higher rank than one of the same message does not count.
    bool store(const ReadValue& value, std::uint8_t rank);
    void storeNetwork(std::string_view network, const Origin& origin);
    void storeOperator(std::string_view name, const Origin& origin);
    /// The leaf holds nothing now: what came from there is not known any more.
    void forgetFrom(PathNumber path);
    /// Measurements of another mode have begun.
    void forgetLevels();
    void forgetLevel(Level level);
    void forgetNetwork();
    /// Derives what follows from the values, when any of them has changed.
    void finish();

private:
    void forget(CellKey key);

    Cell _cell;
    BandHints _hints;
    PathNumber _bandPath = 0;
    PathNumber _uplinkPath = 0;
    std::array<std::uint8_t, LevelCount> _ranks {};
    bool _isPartsStale = false;
    bool _isBandStale = false;
};

} // namespace spectrel
