#pragma once

#include "Analysis/Cell.h"
#include "Values/Moment.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

namespace spectrel {

/// A move from one cell to another as far as it has been shown.
struct CellMove {
    std::uint64_t n = 0; // the first message that shows any value of the new cell
    Moment time {}; // its time
    std::optional<Cell> from; // with the levels last known; none: the session's first cell
    Cell to; // what was stored since the move, with the levels first known
    bool isAfterLoss = false; // there was no service in between

    /// Whether the new cell is known well enough to be named: its channel and one of its identities.
    bool isNamed() const
    {
        return to.channel && (to.id || to.cell);
    }
};

/// What the message has stored of the cell.
Cell storedBy(const Cell& cell, std::uint64_t message);

/// The keys in which two cells differ that are known of both, of technology, band, channel, id and cell.
std::vector<std::string_view> differences(const Cell& from, const Cell& to);

/// Tells one cell from the next in what message after message stores of the serving cell.
///
/// A value that contradicts the cell begins a move. The messages of the next `SettlingTime` complete the new cell; from
/// then on, or when the phone moves again, the move is settled. One that is not named by then waits until it is.
class MoveTracker {
public:
    static constexpr std::chrono::seconds SettlingTime {6};

    /// Whether the values belong to another cell than the one the phone is on, or are the first of all.
    bool isElsewhere(const Cell& stored) const;
    /// The phone is elsewhere: a move begins. A move that has not been settled is part of it.
    void begin(const Cell& stored, std::uint64_t n, Moment time, bool isAfterLoss);
    /// More is known of the cell that the phone is on.
    void learn(const Cell& stored);

    bool isSettling() const
    {
        return _move.has_value();
    }
    const CellMove& move() const
    {
        return *_move;
    }
    /// Whether the move can be reported now that messages up to the time have come.
    bool isDue(Moment time) const
    {
        return _move && _move->isNamed() && time > _move->time + SettlingTime;
    }
    /// Ends the settling.
    CellMove take();
    /// Where the phone is; none before the first cell.
    const std::optional<Cell>& current() const
    {
        return _current;
    }

private:
    std::optional<Cell> _current; // everything stored since it began to serve
    std::optional<CellMove> _move; // while it is settled
};

} // namespace spectrel
