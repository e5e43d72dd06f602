#pragma once

#include "Telephony/Reports/LTEReports.h"
#include "Telephony/Simulator/LTE/LTERoad.h"
#include "Telephony/Simulator/Move.h"

#include <chrono>
#include <cstddef>
#include <optional>
#include <vector>

namespace spectrel {

/// An idle phone's care for its cell: judges it once in each cycle and decides what to measure and where to move
/// (3GPP TS 36.304, 5.2.4).
///
/// Another cell is a candidate when
/// - its carrier has a higher priority and its Srxlev exceeds the carrier's high threshold;
/// - it is on the same carrier and stronger than the serving cell by the hysteresis;
/// - it has a lower priority, the serving cell's Srxlev is below its low threshold and the candidate's exceeds its own.
/// A candidate that stays one for the reselection time is moved to, the highest priority first. Cells of other radio
/// technologies are reported, but the phone stays with LTE.
class LTEIdleMode {
public:
    struct Reselection {
        std::size_t cell;
        ReselectionRule rule;
    };

    /// The paging cycle: near the usual 1.28 s, in whole steps of the simulation.
    static constexpr std::chrono::milliseconds Cycle {1200};
    static constexpr double QHyst = 4; // dB
    static constexpr std::chrono::milliseconds TReselection {2400}; // in whole cycles
    static constexpr unsigned CyclesUntilLost = 4; // with Srxlev below 0, until any suitable cell will do

    explicit LTEIdleMode(const LTERoad& road);
    LTEIdleMode(const LTEIdleMode&) = delete;
    LTEIdleMode& operator=(const LTEIdleMode&) = delete;

    /// Forgets what was measured: a phone comes from a connection, or has moved.
    void start(std::size_t serving);
    /// One cycle. Returns the cell to move to, if any, and by which rule.
    std::optional<Reselection> cycle();

    /// What is left to a phone without a suitable cell.
    std::optional<std::size_t> strongestSuitable() const;

    const LTEServingReport& serving() const
    {
        return _report;
    }
    /// One of the carriers that the rules have the phone measure, in turn; without neighbours where there are none.
    LTENeighbourReport neighbours() const;
    /// One of the candidates, in turn: the record holds no second one whole.
    ReselectionReport candidate() const;

private:
    bool isCandidate(const LTECell& cell) const;
    bool isCandidate(const OtherCell& cell) const;
    void judgeServing();
    void judgeOthers();
    std::vector<const LTELayer*> carriersToMeasure() const;
    std::optional<std::size_t> bestOf(std::chrono::milliseconds minTime) const;
    ReselectionRule ruleFor(const LTECell& cell) const;
    const LTECell& servingCell() const
    {
        return _road.cells()[_serving];
    }

    const LTERoad& _road;
    std::size_t _serving = 0;
    LTEServingReport _report;
    std::vector<std::chrono::milliseconds> _candidateFor; // for each cell; 0: it is none
    std::vector<ReselectionCandidate> _candidates;
    std::size_t _turn = 0;
};

} // namespace spectrel
