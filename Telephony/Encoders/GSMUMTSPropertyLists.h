#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/GSMUMTSReports.h"
#include "Values/Bytes.h"

#include <optional>

/// Records of a GSM/UMTS phone's extra stream, whose payloads are property lists.
namespace spectrel {

struct GSMUMTSCellInformation;

/// 0xFF0000: the SIM's elementary files, with the places where the phone is registered for calls and for packets.
Bytes gsmumtsSIMFilesRecord(const Place& location, const Place& routing, Moment time);

/// 0xFF0001: the serving cell and its neighbours on both systems; a level that is not measured is 32767.
Bytes gsmumtsCellInformationRecord(const GSMUMTSCellInformation& information, Moment time);

/// 0xFF0002: the packet data contexts, with what they have transferred; empty between sessions.
Bytes packetContextsRecord(const std::optional<PacketTransfer>& session, Moment time);

} // namespace spectrel
