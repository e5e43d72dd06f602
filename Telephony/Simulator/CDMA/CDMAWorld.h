#pragma once

#include "Telephony/Simulator/CDMA/EVDOCounters.h"
#include "Telephony/Simulator/MastRoad.h"
#include "Telephony/Simulator/Radio.h"

#include <chrono>
#include <cstdint>
#include <vector>

namespace spectrel {

/// One sector of a CDMA2000 site, on its 1x and its EV-DO carrier.
struct CDMASector {
    std::uint16_t pn = 0; // offset of its pilot in units of 64 chips, 0 to 511
    std::uint16_t systemId = 0;
    std::uint16_t networkId = 0;
    std::uint16_t baseId = 0;
    std::uint8_t packetZone = 0;
    bool isHome = true;
    double power = 0; // mW, as heard now
    bool isActive = false; // in the set of pilots that a call or session holds on to
    std::chrono::milliseconds weakFor {0};
};

/// A pilot as the phone hears it.
struct CDMAPilot {
    std::uint16_t pn;
    double share; // of all the power received on the carrier, linear
};

/// A phone that can do one thing at a time: 1x while it talks, EV-DO while it has data to move.
///
/// The same seed gives the same drive. It goes through idle times, a data session and a voice call every two minutes.
class CDMAWorld {
public:
    enum class Activity : std::uint8_t { Idle, DataSetup, Data, Voice };

    CDMAWorld(Scene scene, std::uint32_t seed);

    void advance(std::chrono::milliseconds step);

    Activity activity() const;
    /// Whether an idle phone listens to its paging channel just now, or sleeps.
    bool isAwake() const;
    const CDMASector& serving() const
    {
        return _sectors[_serving];
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

    /// Seconds since the beginning, and the session's counters as they stood then: both move once a second.
    std::uint32_t second() const
    {
        return _second;
    }
    const EVDOCounters& countersAtSecond() const
    {
        return _atSecond;
    }

private:
    void measure();
    void reselect();
    void maintainActiveSet(std::chrono::milliseconds step);
    double shareOf(const CDMASector& sector) const
    {
        return sector.power / _total;
    }

    Dice _dice;
    MastRoad _road;
    std::vector<CDMASector> _sectors; // one a mast
    Shadowing _secondAntenna;
    double _total = 0; // mW, noise included
    std::size_t _serving = 0;
    std::chrono::milliseconds _elapsed {0};
    bool _isFrameBad = false;
    EVDOCounters _counters;
    EVDOCounters _atSecond;
    std::uint32_t _second = 0;
};

} // namespace spectrel
