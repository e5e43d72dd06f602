#pragma once

#include "Telephony/Simulator/Baseband.h"
#include "Values/Result.h"

#include <chrono>
#include <functional>
#include <string>

namespace spectrel {

/// The moment at which every simulated recording begins, so that the same options give the same bytes:
/// 2026-01-01 08:00:00 UTC.
constexpr Moment SimulatedRecordingStart {std::chrono::seconds(1767254400)};

/// Hears of each move that the simulated world decides, at the time of the decision.
using MoveHandler = std::function<void(Moment time, const Move& move)>;

/// Writes as much of the baseband's life into a capture file as `duration` says, without waiting. When its technology
/// changes it goes on in a further file: "drive.pcap", "drive-2.pcap" and so on; all are overwritten. A failure names
/// the file.
Outcome writeSimulatedRecording(
    Baseband& baseband, const std::string& path, std::chrono::milliseconds duration, const MoveHandler& onMove = {});

} // namespace spectrel
