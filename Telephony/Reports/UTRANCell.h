#pragma once

#include <cstdint>

namespace spectrel {

/// One cell of a TD-SCDMA network (UTRA TDD, 1.28 Mchip/s) as the phone could measure it.
struct UTRANCell {
    std::uint32_t identity = 0; // 28 bits: the controller's number * 65536 + cell
    std::uint16_t locationArea = 0;
    std::uint8_t registrationArea = 0; // URA
    std::uint16_t channel = 0; // UARFCN: 5 * MHz (3GPP TS 25.102, 5.4.4)
    std::uint8_t cellParameterId = 0; // 0 to 127: its scrambling code's number (3GPP TS 25.223, table 6)
    double position = 0; // metres along the road
    double offset = 0; // metres beside it
    double rscp = -130; // dBm, of its common control channel, now
};

/// What the network broadcasts for reselection (3GPP TS 25.304, 5.2.3 and 5.2.6), the same in every cell. It broadcasts
/// no Sintrasearch: a phone measures the serving cell's channel always.
namespace UTRANThresholds {
constexpr double QRxLevMin = -103; // dBm
constexpr double SInterSearch = 50; // dB of Srxlev
constexpr double QHyst1s = 4; // dB
} // namespace UTRANThresholds

/// One GSM cell beside the UTRAN ones.
struct GSMNeighbour {
    std::uint16_t identity = 0; // 14 bits
    bool isPCSBand = false; // 1900 MHz instead of 1800 MHz
    std::uint8_t networkColour = 0; // 0 to 7, as the base station's
    std::uint8_t stationColour = 0;
    std::uint16_t channel = 0; // ARFCN
    double position = 0; // metres along the road
    double rssi = -115; // dBm, now
};

} // namespace spectrel
