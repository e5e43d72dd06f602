#pragma once

#include "Telephony/Simulator/Demand.h"
#include "Telephony/Simulator/GSMUMTS/GSMUMTSRoad.h"
#include "Telephony/Simulator/Move.h"

#include <chrono>
#include <vector>

namespace spectrel {

/// The UMTS half of a phone: which cell it camps on, its cell sets, its RRC connection.
///
/// Idle, the active set is the serving cell alone, and reselection goes by the ranking of 3GPP TS 25.304, 5.2.6.1.4.
/// On a channel of its own the set has up to three cells, which come and go by the events 1a, 1b and 1c of
/// 3GPP TS 25.331, 14.1.2; its strongest cell serves.
class UMTSReceiver {
public:
    /// `moves`: of the world; notes the moves within UMTS.
    UMTSReceiver(const GSMUMTSRoad& road, MoveLog& moves);

    /// Enters UMTS on its strongest cell; by handover, with a channel at once.
    void enter(RRCState state);
    void leave();
    void advance(std::chrono::milliseconds step, const Demand& demand);

    bool isOn() const
    {
        return !_active.empty();
    }
    /// The serving cell; only while on.
    const UMTSCell& servingCell() const
    {
        return _cells[_serving];
    }
    RRCState state() const
    {
        return _state;
    }
    bool isConnected() const
    {
        return _state != RRCState::Disconnected && _state != RRCState::Connecting;
    }
    bool isCiphering() const;

    /// Cells of the active set, strongest first.
    std::vector<const UMTSCell*> activeSet() const;
    /// Of all cells, whether entered or not.
    const UMTSCell& strongestCell() const;
    CellSetsReport cellSets() const;
    /// Neighbours that can be heard, ranked, best first.
    std::vector<RankedUMTSCell> ranking() const;
    /// R of the serving cell.
    double servingRank() const;

private:
    struct Timers {
        std::chrono::milliseconds heard {0};
        std::chrono::milliseconds enters {0}; // for so long event 1a or 1c has held
        std::chrono::milliseconds leaves {0}; // event 1b
        double averageRscp = -115; // dBm, as cells are ranked
    };

    void listen(std::chrono::milliseconds step);
    void reselect(std::chrono::milliseconds step);
    void updateActiveSet(std::chrono::milliseconds step);
    void admit(std::chrono::milliseconds step);
    void dismiss(std::chrono::milliseconds step);
    void advanceConnection(std::chrono::milliseconds step, const Demand& demand);
    void become(RRCState state);
    RRCState nextState(const Demand& demand) const;
    RRCState afterDedicated(const Demand& demand) const;
    RRCState afterShared(const Demand& demand) const;
    RRCState afterPaging(const Demand& demand) const;
    void serveOnly(std::size_t cell);
    bool isActive(std::size_t cell) const;
    bool isNeighbour(const UMTSCell& cell) const;
    std::size_t strongestActive() const;
    std::size_t weakestActive() const;
    UMTSSetCell setCell(std::size_t cell, CellSet set) const;

    const GSMUMTSRoad& _road;
    const std::vector<UMTSCell>& _cells;
    MoveLog& _moves;
    std::vector<Timers> _timers; // one for each cell
    std::vector<std::size_t> _active; // empty while off
    std::size_t _serving = 0;
    std::size_t _candidate = 0;
    std::chrono::milliseconds _candidateFor {0};
    RRCState _state = RRCState::Disconnected;
    std::chrono::milliseconds _inState {0};
    std::chrono::milliseconds _unused {0}; // a connection without demand
    std::chrono::milliseconds _connectedFor {0};
};

} // namespace spectrel
