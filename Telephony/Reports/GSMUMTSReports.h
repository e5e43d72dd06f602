#pragma once

#include "Telephony/Reports/GSMUMTSStates.h"

#include <array>
#include <cstdint>
#include <optional>
#include <vector>

/// What a GSM/UMTS phone reports about itself, in natural units; the encoders write it as log records.
namespace spectrel {

// Mobility

struct MMReport {
    MMState state = MMState::Null;
    MMSubState subState = MMSubState::None;
    UpdateStatus status = UpdateStatus::NotUpdated;
    friend bool operator==(const MMReport&, const MMReport&) = default;
};

struct GMMReport {
    GMMState state = GMMState::Null;
    GMMSubState subState = GMMSubState::None;
    UpdateStatus status = UpdateStatus::NotUpdated;
    friend bool operator==(const GMMReport&, const GMMReport&) = default;
};

struct RegistrationReport {
    RegistrationState state = RegistrationState::Inactive;
    PLMNSelection selection = PLMNSelection::Automatic;
    friend bool operator==(const RegistrationReport&, const RegistrationReport&) = default;
};

/// A public land mobile network, digit by digit.
struct PLMN {
    std::array<std::uint8_t, 3> countryDigits {};
    std::array<std::uint8_t, 3> networkDigits {};
    bool twoNetworkDigits = false; // the third is none
    friend bool operator==(const PLMN&, const PLMN&) = default;
};

/// The network a test card belongs to: country 001, network 01.
constexpr PLMN TestNetwork {{0, 0, 1}, {0, 1, 0}, true};

struct NetworkReport {
    std::uint8_t operatingMode = 1; // 0 to 2: network modes of operation I to III (3GPP TS 23.060, 6.3.3)
    ServiceType service = ServiceType::None;
    std::optional<PLMN> network; // none while no network is found
    std::uint16_t locationArea = 0xFFFE; // 0xFFFE: none (3GPP TS 23.003, 4.1)
    std::uint8_t routingArea = 0xFF;
    friend bool operator==(const NetworkReport&, const NetworkReport&) = default;
};

/// Where a phone is, as its network counts places.
struct Place {
    RadioSystem system = RadioSystem::None;
    std::uint16_t locationArea = 0xFFFE;
    std::uint8_t routingArea = 0xFF;
    friend bool operator==(const Place&, const Place&) = default;
};

/// What a packet data session has transferred.
struct PacketTransfer {
    std::uint64_t bytesReceived = 0;
    std::uint64_t bytesSent = 0;
};

// UMTS

/// The sets of 3GPP TS 25.331, 8.4.0.
enum class CellSet : std::uint8_t { Active = 0, Monitored = 1, Detected = 2 };

/// How far the receiver's averages of a cell's energy have come.
enum class EnergyAverages : std::uint8_t { None, Short, Long };

struct UMTSSetCell {
    std::uint16_t scramblingCode = 0; // 0 to 511
    CellSet set = CellSet::Active;
    double ecno = 0; // dB
    EnergyAverages averages = EnergyAverages::Long;
};

struct CellSetsReport {
    double rssi = 0; // dBm, the carrier's
    std::vector<UMTSSetCell> cells;
};

struct RankedUMTSCell {
    std::uint16_t downlinkChannel = 0; // UARFCN
    std::uint16_t scramblingCode = 0;
    double rscp = 0; // dBm
    double rankedRscp = 0; // dBm, averaged
    double ecno = 0; // dB
    double rank = 0; // R of 3GPP TS 25.304, 5.2.6.1.4
    bool isMeasured = true; // heard for long enough to know its level
};

struct RankedGSMCell {
    std::uint16_t arfcn = 0;
    std::uint16_t bsic = 0;
    double rssi = 0; // dBm
    double rank = 0;
};

struct RankingReport {
    std::vector<RankedUMTSCell> umts;
    std::vector<RankedGSMCell> gsm;
};

/// Uplink power in dBm of each sample; none where nothing was sent.
using TransmitPowers = std::vector<std::optional<double>>;

struct TransportChannelBlocks {
    std::uint8_t identity = 0;
    std::uint32_t received = 0; // blocks with a checksum
    std::uint32_t wrong = 0;
};

struct BlockErrorReport {
    std::uint16_t window = 0; // in radio frames of 10 ms
    std::vector<TransportChannelBlocks> channels;
};

enum class HSDPACarriers : std::uint8_t { Single = 0, MIMO = 1, Dual = 2 };

struct HARQProcess {
    std::uint8_t identity = 0;
    std::uint32_t bits = 0;
    std::uint16_t newTransmissions = 0;
    std::uint16_t blockErrors = 0;
};

struct HSDPAReport {
    std::uint16_t subFrames = 0; // of 2 ms, 0 to 1023
    HSDPACarriers carriers = HSDPACarriers::Single;
    std::vector<HARQProcess> primary; // one for each process
    std::vector<HARQProcess> secondary;
};

// GSM

/// The serving cell's level and, in a call, its quality; idle, the path-loss criteria.
struct GSMMeasurement {
    struct Neighbour {
        std::uint16_t arfcn = 0;
        std::uint8_t rxLevel = 0;
        std::int32_t c1 = 0;
        std::int32_t c2 = 0;
    };
    std::uint16_t arfcn = 0;
    std::uint8_t rxLevel = 0; // 0 to 63: dBm + 110 (3GPP TS 45.008, 8.1.4)
    bool isDedicated = false;
    std::int32_t c1 = 0; // idle (3GPP TS 45.008, 6.4)
    std::int32_t c2 = 0;
    std::uint8_t fullQuality = 0; // dedicated: 0 to 7 (3GPP TS 45.008, 8.2.4)
    std::uint8_t subQuality = 0;
    std::uint8_t reselectHysteresis = 0; // dB, 0 where none is applied
    std::vector<Neighbour> neighbours;
};

struct IdentifiedGSMCell {
    std::uint16_t arfcn = 0;
    std::uint8_t bsic = 0; // 0 to 63
};

struct RRReport {
    RRState state = RRState::Inactive;
    std::uint8_t subState = 0;
    std::uint8_t status = 0;
    bool isData = false;
    friend bool operator==(const RRReport&, const RRReport&) = default;
};

/// The frequencies that a dedicated channel hops over (3GPP TS 45.002, 6.2.3).
struct HoppingReport {
    std::uint8_t sequenceNumber = 0; // HSN, 0 to 63
    std::vector<std::uint16_t> arfcns;
    friend bool operator==(const HoppingReport&, const HoppingReport&) = default;
};

/// GPRS parameters of a cell (3GPP TS 44.060, 12.24). 255 where none is known.
struct GPRSParameters {
    std::uint8_t si13Position = 255; // 0: normal, 1: extended BCCH
    std::uint8_t networkControlOrder = 255; // 0 to 2
    std::uint8_t packetFlowContexts = 255; // 0 or 1
    std::uint8_t priorityAccessThreshold = 255; // 0 to 7
    std::uint8_t t3192 = 0; // 0 to 7
    std::uint8_t drxTimerMax = 0; // s
    bool elevenBitAccessBursts = false;
    bool hasPBCCH = false;
    std::uint8_t psiStatus = 0;
    std::uint8_t countLR = 0;
    std::uint8_t countHR = 0;
    std::uint8_t extendedMeasurementOrder = 0;
    bool packetSIStatus = false;
    friend bool operator==(const GPRSParameters&, const GPRSParameters&) = default;
};

} // namespace spectrel
