#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/GSMUMTSReports.h"
#include "Values/Bytes.h"

/// Records of a GSM/UMTS phone's UMTS receiver. Lists longer than their 8-bit count are cut.
namespace spectrel {

/// 0x417A: the carrier's level, each cell's code and set, each cell's energy.
Bytes cellSetsRecord(const CellSetsReport& report, Moment time);

/// 0x4005: the neighbours ranked for reselection, the UMTS cells and behind them the GSM cells.
///
/// A reader takes both from the same place, so that GSM cells show as they are only in a record without UMTS cells.
Bytes rankingRecord(const RankingReport& report, Moment time);

/// 0x4125, 14 bytes.
Bytes rrcStateRecord(RRCState state, Moment time);

/// 0x4031: the samples of the uplink power.
Bytes transmitPowerRecord(const TransmitPowers& powers, Moment time);

struct UMTSCell;

/// 0x4127, 29 bytes.
Bytes umtsServingCellRecord(const UMTSCell& cell, Moment time);

/// 0x4157, 19 bytes.
Bytes cipheringRecord(bool isOn, Moment time);

/// 0x4116: blocks received and wrong for each transport channel.
Bytes blockErrorRecord(const BlockErrorReport& report, Moment time);

/// 0x4221: what the HARQ processes of each carrier received. Secondary processes stand 162 bytes behind the first
/// primary one for each primary process.
Bytes hsdpaRecord(const HSDPAReport& report, Moment time);

} // namespace spectrel
