#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/GSMUMTSReports.h"
#include "Values/Bytes.h"

/// Records of the serving GSM cell's GPRS parameters; each carries some of them.
namespace spectrel {

/// 0x51F4, 15 bytes: where system information 13 stands.
Bytes gprsSystemInformationRecord(const GPRSParameters& parameters, Moment time);

/// 0x51F5, 18 bytes: packet flow contexts, access threshold, network control order.
Bytes gprsAccessRecord(const GPRSParameters& parameters, Moment time);

/// 0x51F6, 24 bytes: timers and access bursts.
Bytes gprsTimersRecord(const GPRSParameters& parameters, Moment time);

/// 0x51FB, 34 bytes: whether there is a PBCCH.
Bytes gprsBroadcastRecord(const GPRSParameters& parameters, Moment time);

/// 0x51FD, 35 bytes: packet system information, counters, measurement order.
Bytes gprsStatusRecord(const GPRSParameters& parameters, Moment time);

} // namespace spectrel
