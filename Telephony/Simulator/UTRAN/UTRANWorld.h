#pragma once

#include "Telephony/Reports/UTRANCell.h"
#include "Telephony/Reports/UTRANReports.h"
#include "Telephony/Simulator/Coverage.h"
#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/Move.h"
#include "Telephony/Simulator/Propagation.h"
#include "Telephony/Simulator/RRCConnection.h"
#include "Telephony/Simulator/Usage.h"

#include <chrono>
#include <cstdint>
#include <span>
#include <vector>

namespace spectrel {

/// A phone that is driven along a road past the sites of a TD-SCDMA network, with GSM cells beside it: who serves it,
/// what else it hears, how its channels fare. The same seed gives the same drive.
class UTRANWorld {
public:
    UTRANWorld(Scene scene, std::uint32_t seed);

    void advance(std::chrono::milliseconds step);

    const UTRANCell& servingCell() const
    {
        return _cells[_serving];
    }
    /// Srxlev: how far the serving cell is above Qrxlevmin, dB. At 0 or below the phone may only call for help.
    double srxlev() const
    {
        return servingCell().rscp - UTRANThresholds::QRxLevMin;
    }
    bool isInService() const
    {
        return srxlev() > 0;
    }
    RRCMode mode() const
    {
        return _connection.mode();
    }
    /// The other cells, strongest first.
    std::vector<const UTRANCell*> otherCells() const;
    /// The cells that the network names are monitored: those on the serving cell's channel always, those on others on a
    /// dedicated channel or when the serving cell has fallen far enough. On a dedicated channel the serving cell is the
    /// active set, and strong cells on its channel that the network does not name are detected.
    std::vector<UTRANNeighbour> neighbours() const;
    /// Strongest first.
    std::vector<GSMNeighbour> gsmNeighbours() const;
    /// Empty unless the phone is on a dedicated channel.
    TransportReport transportChannels() const;
    /// What was decided in the last step.
    std::span<const Move> moves() const
    {
        return _moves.moves();
    }
    std::uint64_t bytesReceived() const
    {
        return static_cast<std::uint64_t>(_received);
    }
    std::uint64_t bytesSent() const
    {
        return static_cast<std::uint64_t>(_sent);
    }

    // On a journey between technologies, as `TechnologyPart` says.
    void advanceAway(std::chrono::milliseconds step);
    Coverage coverage() const;
    double servingMargin() const;
    CellName servingName() const;
    bool isOnOwnChannel() const;
    bool isSettled() const;
    void arrive(Technology from, MoveKind how);
    void leave();
    void setOthers(const Coverage& utran, const Coverage& gsm);

private:
    bool isCalling() const
    {
        return _journey.scene() == Scene::Handover || _calls.isOn();
    }
    void buildRoad();
    void advanceRoad(std::chrono::milliseconds step);
    std::size_t strongest() const;
    void measure();
    void reselect(std::chrono::milliseconds step);
    MoveCause causeOfMove() const;
    bool isNamed(const UTRANCell& cell) const;
    bool isMeasured(const UTRANCell& cell) const;
    bool isDetected(const UTRANCell& cell) const;
    void controlPower();

    Dice _dice;
    double _roadLength; // metres
    Valley _siteLess; // no sites there
    Journey _journey;
    std::vector<UTRANCell> _cells;
    std::vector<Shadowing> _shadowing; // one for each cell
    std::vector<GSMNeighbour> _gsmCells;
    std::vector<Shadowing> _gsmShadowing;
    std::size_t _serving = 0;
    std::size_t _candidate = 0; // ranked above the serving cell
    std::chrono::milliseconds _candidateFor {0};
    Habit _calls;
    Habit _transfers;
    RRCConnection _connection;
    MoveLog _moves;
    double _signalToInterference = 0; // dB, of the dedicated channels
    double _received = 0;
    double _sent = 0;
};

} // namespace spectrel
