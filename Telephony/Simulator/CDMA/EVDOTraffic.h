#pragma once

#include "Telephony/Reports/EVDOCounts.h"
#include "Telephony/Simulator/Dice.h"

#include <array>
#include <chrono>

namespace spectrel {

/// The packets of an EV-DO session.
class EVDOTraffic {
public:
    /// The data of one step at a SINR in dB on the forward link and a transmitter power in dBm on the reverse.
    void advance(std::chrono::milliseconds step, double signal, double power, Dice& dice);

    const EVDOCounts& counts() const
    {
        return _counts;
    }

private:
    void advanceForward(double slots, double signal, Dice& dice);
    void advanceReverse(double subframes, double power, Dice& dice);

    EVDOCounts _counts;
    double _slots = 0; // allotted and not filled yet
    std::array<double, EVDOCounts::Interlaces> _subframes {}; // likewise
};

} // namespace spectrel
