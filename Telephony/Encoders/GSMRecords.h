#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/GSMUMTSReports.h"
#include "Values/Bytes.h"

#include <span>

/// Records of a GSM/UMTS phone's GSM receiver. Lists longer than their 8-bit count are cut.
namespace spectrel {

struct GSMCell;

/// 0x5134, 26 bytes: the serving cell's identity.
Bytes gsmServingCellRecord(const GSMCell& cell, Moment time);

/// 0x5137: the serving cell's level and the neighbours. The same two fields carry C1 and C2 while idle and the
/// full and sub qualities in a dedicated mode.
Bytes gsmMeasurementRecord(const GSMMeasurement& measurement, Moment time);

/// 0x51FF: the identities of the neighbours that have been synchronised to.
Bytes neighbourIdentitiesRecord(std::span<const IdentifiedGSMCell> cells, Moment time);

/// 0x5076, 17 bytes: the frequency of the dedicated channel.
Bytes dedicatedChannelRecord(std::uint16_t arfcn, Moment time);

/// 0x512C, 17 bytes.
Bytes rrStateRecord(const RRReport& report, Moment time);

/// 0x5072, 20 bytes: discontinuous transmission.
Bytes dtxRecord(bool isUsed, Moment time);

/// 0x51F8: hopping sequence and frequencies.
Bytes mobileAllocationRecord(const HoppingReport& report, Moment time);

} // namespace spectrel
