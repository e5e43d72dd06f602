#pragma once

#include "Telephony/Reports/GSMUMTSReports.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

/// One sector of a NodeB as the phone could measure it.
struct UMTSCell {
    std::uint32_t identity = 0; // 28 bits: the radio network controller's 12, the cell's 16
    std::uint16_t scramblingCode = 0; // primary, 0 to 511
    std::uint16_t downlinkChannel = 0; // UARFCN (3GPP TS 25.101, 5.4.4)
    std::uint16_t uplinkChannel = 0; // UARFCN, 950 below the downlink's in band I
    std::uint16_t locationArea = 0;
    std::uint8_t routingArea = 0;
    std::uint16_t registrationArea = 0; // URA
    HSDPACarriers carriers = HSDPACarriers::Single;
    std::size_t site = 0;
    double position = 0; // metres along the road
    double offset = 0; // metres beside it
    double azimuth = 0; // degrees, 0 being ahead along the road
    double power = 0; // dBm, common pilot, antenna gain and the car's loss included
    double load = 0; // dB, all the cell's power over the pilot's
    double rscp = 0; // dBm, as heard now
    double ecno = 0; // dB, as heard now: rscp over everything on the carrier
};

/// What cell selection asks of a cell (3GPP TS 25.304, 5.2.3.1.2), as the simulated network broadcasts it.
namespace UMTSThresholds {
constexpr double QQualMin = -18; // dB
constexpr double QRxLevMin = -115; // dBm
constexpr double SearchGSMBelow = -14; // dB of Ec/No: Qqualmin + SsearchRAT
constexpr double QHyst1s = 2; // dB
constexpr double QOffset1 = 7; // dB, of GSM neighbours
} // namespace UMTSThresholds

} // namespace spectrel
