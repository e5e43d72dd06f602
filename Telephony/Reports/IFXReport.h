#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

namespace spectrel {

/// One GSM 900 cell as the phone could measure it.
struct IFXCell {
    std::uint16_t channel = 0; // ARFCN, 1 to 124 (3GPP TS 45.005, clause 2)
    std::uint8_t networkColour = 0; // NCC and BCC, 0 to 7
    std::uint8_t stationColour = 0;
    std::uint16_t locationArea = 0;
    std::uint16_t identity = 0;
    std::uint8_t routingArea = 0;
    double level = 0; // dBm, as heard now
};

/// A phone of the dictionary-reporting baseband at one moment.
struct IFXReport {
    bool isInService = true;
    IFXCell serving; // or the lost one
    std::vector<IFXCell> neighbours; // strongest first
    bool isTalking = false;
    std::chrono::seconds talkingFor {0}; // since the call began; 0 without one
    unsigned quality = 0; // RXQUAL, 0 (best) to 7 (3GPP TS 45.008, 8.2.4)
    unsigned timingAdvance = 0; // distance to the serving cell in steps of 554 m, 0 to 63
    unsigned cellsVisited = 1; // cells that have served, this one included
    std::uint64_t bytesReceived = 0;
    std::uint64_t bytesSent = 0;
};

} // namespace spectrel
