#pragma once

#include "Telephony/Reports/GSMUMTSReports.h"

#include <cstdint>

namespace spectrel {

/// One GSM cell as the phone could measure it.
struct GSMCell {
    std::uint16_t identity = 0;
    std::uint16_t arfcn = 0; // of the broadcast carrier: 1 to 124 (900 MHz), 512 to 885 (1800 MHz)
    std::uint8_t bsic = 0; // colour codes of network and base station, 3 bits each
    std::uint16_t locationArea = 0;
    std::uint8_t routingArea = 0;
    std::uint8_t reselectOffset = 0; // dB, CELL_RESELECT_OFFSET
    bool usesDTX = false;
    HoppingReport hopping; // no frequencies: none
    GPRSParameters gprs;
    double position = 0; // metres along the road
    double offset = 0; // metres beside it
    double power = 0; // dBm, antenna gain and the car's loss included, less what the band adds to the path loss
    double rssi = 0; // dBm, as heard now

    /// The path-loss criteria (3GPP TS 45.008, 6.4).
    double c1() const;
    double c2() const
    {
        return c1() + reselectOffset;
    }
};

/// 0 to 63: dBm + 110 (3GPP TS 45.008, 8.1.4).
std::uint8_t rxLevel(double rssi);

} // namespace spectrel
