#pragma once

#include "Platform/Clock.h"
#include "Values/Bytes.h"

namespace spectrel {

struct LTECell;
struct LTEConnectedReport;
struct LTENeighbourReport;
struct LTEServingReport;
struct ReselectionReport;

/// 0xB0C2, serving cell configuration, 38 bytes.
Bytes lteServingCellRecord(const LTECell& cell, Moment time);

/// 0xB0C1, broadcast information, 22 bytes: the transmit antennas.
Bytes lteAntennasRecord(const LTECell& cell, Moment time);

/// 0xB179, connected-mode intra-frequency measurement: 29 bytes, 6 a measured neighbour, 2 a detected cell. Of either
/// at most 255 are written.
Bytes lteConnectedModeRecord(const LTEConnectedReport& report, Moment time);

/// 0xB17F, the serving cell's idle-mode measurement and evaluation, 33 bytes.
Bytes lteServingMeasurementRecord(const LTEServingReport& report, Moment time);

/// 0xB180, idle-mode neighbour measurement: 21 bytes, 20 a neighbour. The record cannot say that there is none: without
/// a neighbour it is empty.
Bytes lteNeighbourMeasurementRecord(const LTENeighbourReport& report, Moment time);

/// 0xB186, reselection candidates: 21 bytes, then the candidates, which begin 4 bytes apart and have 12 each, the later
/// ones over the earlier ones.
Bytes lteReselectionRecord(const ReselectionReport& report, Moment time);

} // namespace spectrel
