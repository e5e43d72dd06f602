#pragma once

#include "Platform/Clock.h"
#include "Values/Bytes.h"
#include "Values/Value.h"

#include <cstdint>
#include <span>
#include <string_view>

namespace spectrel {

struct LTECell;

/// A record of the extra stream whose payload is the property list, in its XML form.
Bytes propertyListRecord(std::uint32_t code, const Value& payload, Moment time);

/// What a phone changes on its SIM.
struct SIMFiles {
    std::uint16_t locationArea = 1201; // EF-LOCI: where calls reach it
    std::uint16_t packetLocationArea = 1201; // EF-PSLOCI: where packets do
    std::uint8_t routingArea = 1;
    std::string_view ratMode = "LTE preferred";
};

/// 0xFF0000: the SIM's elementary files. A test card's: MCC 001, MNC 01.
Bytes simFilesRecord(Moment time, const SIMFiles& files = {});

/// 0xFF0001: the serving cell and its neighbours.
Bytes lteCellInformationRecord(const LTECell& serving, std::span<const LTECell* const> neighbours, Moment time);

/// 0xFF0002: the one context of a phone before LTE, with what it has transferred.
Bytes packetContextRecord(std::uint64_t bytesReceived, std::uint64_t bytesSent, Moment time);

/// 0xFF0002: an LTE phone's contexts, with what they have transferred.
Bytes contextsRecord(std::uint64_t bytesReceived, std::uint64_t bytesSent, Moment time);

} // namespace spectrel
