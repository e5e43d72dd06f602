#pragma once

#include "Telephony/Reports/EVDOCounts.h"

#include <cstdint>
#include <vector>

namespace spectrel {

/// What a phone that can do one thing at a time does: 1x while it talks, EV-DO while it has data to move.
enum class CDMAActivity : std::uint8_t { Idle, DataSetup, Data, Voice };

/// The network's carriers, in the band class of 1.8 to 2.0 GHz (3GPP2 C.S0057, 2.1.2).
namespace CDMACarriers {
constexpr std::uint8_t BandClass = 1;
constexpr std::uint16_t OneX = 425;
constexpr std::uint16_t EVDO = 325;
} // namespace CDMACarriers

/// What a sector of a CDMA2000 site broadcasts about itself, on its 1x and its EV-DO carrier.
struct CDMASystem {
    std::uint16_t pn = 0; // offset of its pilot in units of 64 chips, 0 to 511
    std::uint16_t systemId = 0;
    std::uint16_t networkId = 0;
    std::uint16_t baseId = 0;
    std::uint8_t packetZone = 0;
    bool isHome = true;
};

/// A pilot as the phone hears it.
struct CDMAPilot {
    std::uint16_t pn;
    double share; // of all the power received on the carrier, linear
};

/// A CDMA2000 phone at one moment.
struct CDMAReport {
    CDMAActivity activity = CDMAActivity::Idle;
    bool isAwake = true; // idle, whether it listens to its paging channel just now, or sleeps
    bool isInService = true; // otherwise it searches for a pilot
    CDMASystem serving; // or the lost one
    std::vector<CDMAPilot> activePilots; // at least one, the serving one first
    double received = 0; // dBm on a carrier
    double receivedBySecond = 0; // dBm, by the second antenna
    double transmitted = 0; // dBm, -50 to 23
    double servingSignal = 0; // signal to interference and noise at the serving pilot, linear
    bool isFrameBad = false; // whether the newest frame of the voice call has arrived broken
    std::uint32_t second = 0; // since the beginning
    EVDOCounts counts; // as they stood at that second
};

} // namespace spectrel
