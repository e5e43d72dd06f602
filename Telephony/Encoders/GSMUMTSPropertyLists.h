#pragma once

#include "Platform/Clock.h"
#include "Values/Bytes.h"

/// Records of a GSM/UMTS phone's extra stream, whose payloads are property lists.
namespace spectrel {

class GSMUMTSWorld;
class MobilityManagement;

/// 0xFF0000: the SIM's elementary files, with the areas that the phone is registered in.
Bytes gsmumtsSIMFilesRecord(const MobilityManagement& mobility, Moment time);

/// 0xFF0001: the serving cell and its neighbours on both systems; a level that is not measured is 32767.
Bytes gsmumtsCellInformationRecord(const GSMUMTSWorld& world, Moment time);

/// 0xFF0002: the packet data contexts, with what they have transferred; empty between sessions.
Bytes packetContextsRecord(const GSMUMTSWorld& world, Moment time);

} // namespace spectrel
