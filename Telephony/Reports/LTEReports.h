#pragma once

#include "Telephony/Reports/LTECell.h"

#include <cstdint>
#include <optional>
#include <vector>

/// What an LTE phone finds out, for the records. Levels in dBm and dB, channels as E-ARFCN.
namespace spectrel {

/// A measured neighbour in a connection.
struct LTEConnectedNeighbour {
    std::uint16_t physicalCellId = 0;
    LTELevels filtered;
};

/// The serving carrier as measured in a connection.
struct LTEConnectedReport {
    std::uint16_t channel = 0;
    std::uint16_t physicalCellId = 0;
    std::uint8_t subframe = 0; // 0 to 9
    LTELevels filtered;
    std::vector<LTEConnectedNeighbour> measured;
    std::vector<std::uint16_t> detected; // physical cell identities
};

/// The serving cell as idle mode judges it, once in a paging cycle.
struct LTEServingReport {
    std::uint16_t channel = 0;
    std::uint16_t physicalCellId = 0;
    std::uint8_t priority = 0;
    LTELevels measured;
    LTELevels average;
    int qRxLevMin = -140; // dBm
    std::optional<int> pMax; // dBm
    int maxUETransmitPower = 0; // dBm, the phone's own limit
    int srxlev = 0; // dB
    unsigned cyclesBelowZero = 0; // how many in a row Srxlev was below 0
    std::optional<int> sIntraSearch;
    std::optional<int> sNonIntraSearch;
    bool areRulesUpdated = false;
    std::uint8_t rules = 0; // LTEMeasurementRule
};

/// What an idle phone has to measure besides its serving cell.
namespace LTEMeasurementRule {
constexpr std::uint8_t SameCarrier = 1;
constexpr std::uint8_t LowerPriorities = 2;
constexpr std::uint8_t HigherPriorities = 4;
} // namespace LTEMeasurementRule

/// Where a neighbour's frame begins, as one of the phone's two antennas receives it.
struct LTEFrameTiming {
    std::uint16_t frames = 0; // 0 to 1023
    std::uint32_t samples = 0; // of 1/30.72 us, 0 to 307199
};

struct LTEIdleNeighbour {
    std::uint16_t physicalCellId = 0;
    LTELevels measured;
    LTELevels average;
    int srxlev = 0; // dB
    std::uint16_t frequencyOffset = 0; // Hz
    LTEFrameTiming antennas[2];
};

/// One carrier's neighbours as idle mode measures them.
struct LTENeighbourReport {
    std::uint16_t channel = 0;
    int qRxLevMin = -140; // dBm
    std::vector<LTEIdleNeighbour> neighbours; // at least one, at most 32
};

/// Radio access technologies as the reselection record numbers them.
enum class ReselectionTechnology : std::uint8_t { LTE, UTRAN, GERAN, CDMA1xRTT, CDMAHRPD };

/// A cell that an idle phone could move to.
struct ReselectionCandidate {
    ReselectionTechnology technology = ReselectionTechnology::LTE;
    std::uint8_t priority = 0;
    std::uint16_t channel = 0;
    std::uint16_t code = 0; // physical cell identity, scrambling code, base station identity code or pilot offset
    std::uint8_t band = 0; // GERAN: 1 for 1900 MHz; CDMA: band class
};

struct ReselectionReport {
    std::uint16_t servingChannel = 0;
    std::uint16_t servingCellId = 0;
    std::vector<ReselectionCandidate> candidates;
};

} // namespace spectrel
