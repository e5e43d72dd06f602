#pragma once

#include "Telephony/Simulator/Demand.h"
#include "Telephony/Simulator/GSMUMTS/GSMUMTSRoad.h"
#include "Telephony/Simulator/Move.h"

#include <chrono>
#include <vector>

namespace spectrel {

/// The GSM half of a phone: the cell it camps on or talks through, its neighbours, its radio resources.
///
/// Idle, reselection goes by C2 (3GPP TS 45.008, 6.6.2); in a call the network hands over to a stronger cell.
class GSMReceiver {
public:
    /// `moves`: of the world; notes the moves within GSM.
    GSMReceiver(const GSMUMTSRoad& road, MoveLog& moves);

    /// Enters GSM on its strongest cell; the state says how, and lasts about a second.
    void enter(RRState how);
    /// Is about to leave for UMTS; the state says how.
    void depart(RRState how);
    void leave();
    void advance(std::chrono::milliseconds step, const Demand& demand, Dice& dice);

    bool isOn() const
    {
        return _isOn;
    }
    /// On its way from or to UMTS.
    bool isChanging() const;
    /// The serving cell; only while on.
    const GSMCell& servingCell() const
    {
        return _cells[_serving];
    }
    const GSMCell& strongestCell() const;
    bool isConnected() const
    {
        return _rr.state == RRState::DataTransfer;
    }
    /// Not in the midst of a change, a setup or a release.
    bool isSettled() const
    {
        return isConnected() || _rr.state == RRState::Idle;
    }
    /// In a call, on a channel of its own.
    bool isDedicated() const
    {
        return isConnected() && _inCall;
    }
    const RRReport& rr() const
    {
        return _rr;
    }
    /// Which of its frequencies a dedicated channel is on.
    std::uint16_t dedicatedArfcn() const;
    /// None outside a call and where the cell does not hop.
    HoppingReport hopping() const;
    bool usesDTX() const
    {
        return isDedicated() && servingCell().usesDTX;
    }
    bool hasReadSystemInformation() const;
    /// The serving cell's, once its system information has been read.
    GPRSParameters gprs() const;
    GSMMeasurement measurement() const;
    /// The strongest other cells, strongest first.
    std::vector<const GSMCell*> neighbours() const;
    std::vector<IdentifiedGSMCell> identified() const;

private:
    void listen(std::chrono::milliseconds step);
    void advanceState(std::chrono::milliseconds step, const Demand& demand);
    RRState nextState(const Demand& demand) const;
    void become(RRState state);
    void reselect(std::chrono::milliseconds step);
    void judgeQuality(Dice& dice);
    void serve(std::size_t cell);

    const std::vector<GSMCell>& _cells;
    MoveLog& _moves;
    std::vector<std::chrono::milliseconds> _heard; // one for each cell
    bool _isOn = false;
    bool _inCall = false;
    bool _inSession = false;
    std::size_t _serving = 0;
    std::size_t _candidate = 0;
    std::chrono::milliseconds _candidateFor {0};
    std::chrono::milliseconds _onCell {0};
    std::chrono::milliseconds _inState {0};
    RRReport _rr;
    std::uint8_t _fullQuality = 0;
    std::uint8_t _subQuality = 0;
};

} // namespace spectrel
