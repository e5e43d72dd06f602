#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/UTRANReports.h"
#include "Values/Bytes.h"

#include <span>

namespace spectrel {

/// 0xD0E0, radio resource control, 15 bytes. Without a cell in service the mode is marked as not valid.
Bytes utranRRCRecord(RRCMode mode, bool isInService, Moment time);

/// 0xD0E2, serving cell, 26 bytes. A phone out of service may only call for help.
Bytes utranServingCellRecord(const UTRANCell& cell, bool isInService, Moment time);

/// 0xD00A, UTRAN cells around: 168 bytes, 16 a cell; at most 127.
Bytes utranNeighbourRecord(std::span<const UTRANNeighbour> cells, Moment time);

/// 0xD00E, GSM cells around: 17 bytes, 8 a cell; at most 255.
Bytes utranGSMNeighbourRecord(std::span<const GSMNeighbour> cells, Moment time);

/// 0xD00C, transport-channel quality. The transport channels have 2 bytes each from byte 17 on; the coded composite
/// ones have 8 and begin at byte 289, 34 bytes later for each transport channel.
Bytes utranTransportChannelRecord(const TransportReport& report, Moment time);

/// 0xFF0000: the SIM's files, which know the serving cell's location area.
Bytes utranSIMFilesRecord(const UTRANCell& cell, Moment time);

/// 0xFF0001: the serving cell and the first four of the others, which come strongest first.
Bytes utranCellInformationRecord(const UTRANCell& serving, std::span<const UTRANCell* const> others, Moment time);

} // namespace spectrel
