#pragma once

#include "Telephony/Reports/LTECell.h"
#include "Telephony/Reports/LTEReports.h"
#include "Telephony/Simulator/Coverage.h"
#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/LTE/LTEIdleMode.h"
#include "Telephony/Simulator/LTE/LTERoad.h"
#include "Telephony/Simulator/Move.h"
#include "Telephony/Simulator/Usage.h"

#include <chrono>
#include <cstdint>
#include <span>
#include <vector>

namespace spectrel {

/// A phone that is driven along a road past LTE sites: who serves it, what else it hears, what it has transferred.
///
/// It is idle and connected by turns: idle it reselects cells as `LTEIdleMode` decides, connected the network hands it
/// over to a cell that is stronger for a while. Where no signal is left it searches for any suitable cell. The same
/// seed gives the same drive.
class LTEWorld {
public:
    LTEWorld(Scene scene, std::uint32_t seed);

    void advance(std::chrono::milliseconds step);

    /// Without service no cell serves: `servingCell` is the lost one.
    bool isInService() const
    {
        return _isInService;
    }
    bool isConnected() const
    {
        return _isInService && wantsConnection() && !_hasLostConnection;
    }
    const LTECell& servingCell() const
    {
        return _road.cells()[_serving];
    }
    const LTERoad& road() const
    {
        return _road;
    }
    /// Idle mode's findings; of the last time when the phone is connected.
    const LTEIdleMode& idleMode() const
    {
        return _idleMode;
    }
    /// What was decided in the last step.
    std::span<const Move> moves() const
    {
        return _moves.moves();
    }
    LTEConnectedReport connectedReport() const;
    /// The strongest other cells, strongest first.
    std::vector<const LTECell*> neighbours(std::size_t maxCount) const;
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
    bool wantsConnection() const
    {
        return _journey.scene() == Scene::Handover || _connection.isOn();
    }
    void searchService();
    void advanceIdle(bool hasJustBecomeIdle);
    void advanceConnection(std::chrono::milliseconds step);
    void handOver(std::chrono::milliseconds step);
    void transfer(std::chrono::milliseconds step);
    void moveTo(std::size_t cell, MoveCause cause);
    std::size_t strongest() const;
    std::size_t bestFromOutside() const;

    Dice _dice;
    Journey _journey;
    LTERoad _road;
    std::size_t _serving = 0;
    LTEIdleMode _idleMode {_road};
    MoveLog _moves;
    Habit _connection;
    bool _isInService = true;
    bool _hasLostConnection = false; // until the habit's next turn
    std::chrono::milliseconds _elapsed {0};
    std::size_t _target = 0; // stronger than the serving cell
    std::chrono::milliseconds _targetFor {0};
    std::uint8_t _subframe = 0;
    double _received = 0;
    double _sent = 0;
};

} // namespace spectrel
