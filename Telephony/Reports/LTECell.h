#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <optional>

namespace spectrel {

/// What the cells of one carrier have in common, with what they broadcast for reselection (3GPP TS 36.304, 5.2.4;
/// 36.331, SystemInformationBlockType3 and 5). Levels in dBm, thresholds in dB above Qrxlevmin.
struct LTELayer {
    std::uint8_t band;
    std::uint16_t downlinkChannel; // E-ARFCN
    std::uint8_t resourceBlocks;
    double power; // dBm a resource element
    std::uint8_t priority; // 0 to 7, the highest wins
    int qRxLevMin; // dBm, even
    std::optional<int> pMax; // dBm
    std::optional<int> sIntraSearch; // even; without it neighbours are always measured
    std::optional<int> sNonIntraSearch; // even
    int threshHigh; // to move up to this layer
    int threshLow; // to move down to it
    int threshServingLow; // below it the phone moves down from here
};

/// Levels of one measurement. They agree: RSRQ = 10 lg N + RSRP - RSSI, N being the carrier's resource blocks.
struct LTELevels {
    double rsrp = -140; // dBm, of one resource element
    double rssi = -110; // dBm, of the carrier's resource blocks
    double rsrq = 0; // dB
};

inline LTELevels lteLevels(double rsrp, double rssi, std::uint8_t resourceBlocks)
{
    return {rsrp, rssi, 10 * std::log10(resourceBlocks) + rsrp - rssi};
}

/// One sector of an LTE site as the phone could measure it.
struct LTECell {
    std::uint32_t identity = 0; // 28 bits: the site's eNodeB number * 256 + sector
    std::uint16_t physicalCellId = 0; // 0 to 503
    std::uint16_t downlinkChannel = 0; // E-ARFCN (3GPP TS 36.101, table 5.7.3-1)
    std::uint16_t uplinkChannel = 0; // E-ARFCN, 18000 above the downlink's in the paired bands
    std::uint8_t band = 0;
    std::uint8_t resourceBlocks = 0; // 6, 15, 25, 50, 75 or 100
    std::uint8_t antennas = 0; // transmit antenna ports
    std::uint16_t trackingArea = 0;
    const LTELayer* layer = nullptr;
    double position = 0; // metres along the road
    double offset = 0; // metres beside it
    double power = 0; // dBm, reference signal
    double load = 0; // 0 to 1: how much of its resources it sends on
    std::uint16_t frequencyOffset = 0; // Hz, of the phone's oscillator from its own
    std::uint16_t frameOffset = 0; // frames, 0 to 1023
    std::uint32_t sampleOffset = 0; // samples of 1/30.72 us, 0 to 307199
    LTELevels measured; // now
    LTELevels average; // filtered over the last measurements

    /// Srxlev, dB (3GPP TS 36.304, 5.2.3.2). The phone may send as strong as any layer allows: no compensation.
    int srxlev() const
    {
        return static_cast<int>(std::floor(average.rsrp)) - layer->qRxLevMin;
    }
};

} // namespace spectrel
