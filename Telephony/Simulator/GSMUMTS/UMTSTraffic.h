#pragma once

#include "Telephony/Simulator/Demand.h"
#include "Telephony/Simulator/GSMUMTS/UMTSReceiver.h"

#include <chrono>

namespace spectrel {

/// What passes over the UMTS radio link, counted as the baseband counts it: uplink power, transport blocks, HSDPA.
///
/// Counts run over windows of a second; within one they grow.
class UMTSTraffic {
public:
    /// By one step of 100 ms.
    void advance(std::chrono::milliseconds step, const UMTSReceiver& umts, const Demand& demand, Dice& dice);

    /// The last samples of the uplink power.
    const TransmitPowers& powers() const
    {
        return _powers;
    }
    const BlockErrorReport& blocks() const
    {
        return _blocks;
    }
    const HSDPAReport& hsdpa() const
    {
        return _hsdpa;
    }
    /// Bits received over HSDPA in the last step.
    double received() const
    {
        return _received;
    }

private:
    void samplePower(const UMTSReceiver& umts, Dice& dice);
    void countBlocks(const UMTSReceiver& umts, const Demand& demand, Dice& dice);
    void countHSDPA(const UMTSReceiver& umts, const Demand& demand, Dice& dice);
    void countCarrier(std::vector<HARQProcess>& processes, double ecno, Dice& dice);

    TransmitPowers _powers;
    BlockErrorReport _blocks;
    HSDPAReport _hsdpa;
    double _received = 0;
    std::chrono::milliseconds _inWindow {0};
    double _wrongOwed = 0; // fractions of a block not yet counted
};

} // namespace spectrel
