#pragma once

#include "Telephony/Reports/IFXReport.h"
#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/MastRoad.h"
#include "Telephony/Simulator/Move.h"

#include <chrono>
#include <cstdint>
#include <span>
#include <vector>

namespace spectrel {

/// A GSM phone on a drive: which cell it is on, what else it hears, whether it talks, what it has transferred.
///
/// The same seed gives the same drive. It makes a call in every second minute.
class IFXWorld {
public:
    IFXWorld(Scene scene, std::uint32_t seed);

    void advance(std::chrono::milliseconds step);

    const IFXCell& serving() const
    {
        return _cells[_serving];
    }
    /// The strongest other cells that can be heard, strongest first.
    std::vector<IFXCell> neighbours() const;
    bool isInService() const
    {
        return _isInService;
    }
    bool isTalking() const;
    /// Seconds since the call began; 0 without one.
    std::chrono::seconds talkingFor() const;
    /// 0 (best) to 7 (3GPP TS 45.008, 8.2.4).
    unsigned quality() const
    {
        return _quality;
    }
    /// Distance to the serving cell in steps of 554 m, 0 to 63.
    unsigned timingAdvance() const;
    /// Cells that have served, this one included.
    unsigned cellsVisited() const
    {
        return _cellsVisited;
    }
    std::uint64_t bytesReceived() const
    {
        return static_cast<std::uint64_t>(_received);
    }
    std::uint64_t bytesSent() const
    {
        return static_cast<std::uint64_t>(_sent);
    }
    /// What was decided in the last step.
    std::span<const Move> moves() const
    {
        return _moves.moves();
    }
    /// All of it, for the message.
    IFXReport report() const;

private:
    void measure();
    void reselect();
    std::size_t strongest() const;

    bool _isAlwaysTalking;
    bool _isInService = true;
    Dice _dice;
    MastRoad _road;
    std::vector<IFXCell> _cells; // one a mast
    std::size_t _serving = 0;
    std::chrono::milliseconds _elapsed {0};
    MoveLog _moves;
    unsigned _quality = 0;
    unsigned _cellsVisited = 1;
    double _received = 0;
    double _sent = 0;
};

} // namespace spectrel
