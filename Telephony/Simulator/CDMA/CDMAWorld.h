#pragma once

#include "Telephony/Reports/CDMAReport.h"
#include "Telephony/Simulator/CDMA/EVDOTraffic.h"
#include "Telephony/Simulator/Dice.h"
#include "Telephony/Simulator/Journey.h"
#include "Telephony/Simulator/MastRoad.h"
#include "Telephony/Simulator/Move.h"
#include "Telephony/Simulator/Propagation.h"

#include <array>
#include <chrono>
#include <cstdint>
#include <span>
#include <vector>

namespace spectrel {

/// One sector of a site as the phone could hear it.
struct CDMASector {
    CDMASystem system;
    double power = 0; // mW, as heard now
    bool isActive = false; // in the set of pilots that a call or session holds on to
    std::chrono::milliseconds weakFor {0};
};

/// A phone that can do one thing at a time: 1x while it talks, EV-DO while it has data to move.
///
/// The same seed gives the same drive. It goes through idle times, a data session and a voice call every two minutes.
class CDMAWorld {
public:
    using Activity = CDMAActivity;

    CDMAWorld(Scene scene, std::uint32_t seed);

    void advance(std::chrono::milliseconds step);

    /// Idle without service.
    Activity activity() const;
    bool isInService() const
    {
        return _isInService;
    }
    /// Whether an idle phone listens to its paging channel just now, or sleeps.
    bool isAwake() const;
    const CDMASystem& serving() const
    {
        return servingSector().system;
    }
    /// The pilots of the active set, the serving one first, the others in their order along the road; idle there is but
    /// one.
    std::vector<CDMAPilot> activePilots() const;
    /// Power received on a carrier, dBm.
    double received() const;
    /// What the second antenna receives, dBm.
    double receivedBySecond() const;
    /// Power to be transmitted, dBm, -50 to 23.
    double transmitted() const;
    /// Signal to interference and noise at the serving pilot, linear.
    double servingSignal() const;
    /// Whether the newest frame of the voice call has arrived broken.
    bool isFrameBad() const
    {
        return _isFrameBad;
    }

    /// Seconds since the beginning, and the session's counts as they stood then: both move once a second.
    std::uint32_t second() const
    {
        return _second;
    }
    const EVDOCounts& countsAtSecond() const
    {
        return _countsAtSecond;
    }
    /// What was decided in the last step.
    std::span<const Move> moves() const
    {
        return _moves.moves();
    }
    /// All of it, for the records.
    CDMAReport report() const;

private:
    /// What the phone does, and until when in each round.
    struct Phase {
        std::chrono::milliseconds end;
        Activity activity;
    };
    static const std::array<Phase, 6> UsualPhases;
    static const std::array<Phase, 2> BusyPhases;

    void measure();
    void reselect();
    void searchService();
    void serve(std::size_t sector, MoveCause cause);
    void followWithEVDO();
    std::size_t best() const;
    void maintainActiveSet(std::chrono::milliseconds step);
    const CDMASector& servingSector() const
    {
        return _sectors[_serving];
    }
    double shareOf(const CDMASector& sector) const
    {
        return sector.power / _total;
    }

    std::span<const Phase> _phases; // of a round
    Dice _dice;
    MastRoad _road;
    std::vector<CDMASector> _sectors; // one a mast
    Shadowing _secondAntenna;
    double _total = 0; // mW, noise included
    std::size_t _serving = 0;
    std::size_t _servingEVDO = 0; // in a voice call, the one before it
    MoveLog _moves;
    std::chrono::milliseconds _elapsed {0};
    bool _isInService = true;
    bool _isFrameBad = false;
    EVDOTraffic _traffic;
    EVDOCounts _countsAtSecond;
    std::uint32_t _second = 0;
};

} // namespace spectrel
