#pragma once

#include "Telephony/Simulator/Radio.h"

#include <chrono>
#include <cstdint>
#include <vector>

namespace spectrel {

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
    double position = 0; // metres along the road
    double offset = 0; // metres beside it
    double power = 0; // dBm, reference signal
    double rsrp = 0; // dBm, as heard now
};

/// A phone that is driven along a road past LTE sites: who serves it, what else it hears, what it has transferred.
///
/// The same seed gives the same drive.
class LTEWorld {
public:
    LTEWorld(Scene scene, std::uint32_t seed);

    void advance(std::chrono::milliseconds step);

    const LTECell& servingCell() const
    {
        return _cells[_serving];
    }
    /// The strongest other cells, strongest first.
    std::vector<const LTECell*> neighbours(std::size_t atMost) const;
    std::uint64_t bytesReceived() const
    {
        return static_cast<std::uint64_t>(_received);
    }
    std::uint64_t bytesSent() const
    {
        return static_cast<std::uint64_t>(_sent);
    }

private:
    void buildRoad();
    void measure();
    void reselect(std::chrono::milliseconds step);

    Dice _dice;
    Journey _journey;
    std::vector<LTECell> _cells;
    std::vector<Shadowing> _shadowing; // one for each cell
    std::size_t _serving = 0;
    std::size_t _candidate = 0; // better than the serving cell
    std::chrono::milliseconds _candidateFor {0};
    double _received = 0;
    double _sent = 0;
};

} // namespace spectrel
