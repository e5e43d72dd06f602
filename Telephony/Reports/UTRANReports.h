#pragma once

#include "Telephony/Reports/UTRANCell.h"

#include <array>
#include <cstdint>
#include <vector>

/// What a UTRAN phone finds out, for the records.
namespace spectrel {

/// As the record numbers them.
enum class RRCMode : std::uint8_t { Disconnected, Connecting, CellFACH, CellDCH, CellPCH, URAPCH };

/// The sets that a UTRAN cell can be in, as the record numbers them.
enum class UTRANCellSet : std::uint8_t { Active, Monitored, Detected };

struct UTRANNeighbour {
    std::uint16_t channel = 0; // UARFCN
    std::uint8_t cellParameterId = 0; // 0 to 127
    double rscp = -130; // dBm
    UTRANCellSet set = UTRANCellSet::Monitored;
    bool isJointlyDetected = false; // its users' signals are detected together with the own one
};

struct TransportChannel {
    std::uint8_t number = 0;
    std::uint8_t blockErrors = 0; // percent
};

struct CodedCompositeChannel {
    std::uint8_t number = 0;
    std::uint8_t slots = 0; // how many time slots it has
    /// Signal to interference of each slot in steps of 0.5 dB from -11 dB, 0 for a slot that it has not (3GPP
    /// TS 25.123, 9.1.1.5.3).
    std::array<std::uint8_t, 6> signalToInterference {};
};

struct TransportReport {
    std::vector<TransportChannel> channels; // at most 63
    std::vector<CodedCompositeChannel> composites; // at most 15
};

} // namespace spectrel
