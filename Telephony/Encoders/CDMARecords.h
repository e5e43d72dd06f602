#pragma once

#include "Platform/Clock.h"
#include "Telephony/Reports/CDMAReport.h"
#include "Values/Bytes.h"

namespace spectrel {

// Records of both carriers. One that the phone does not make in its present activity is empty.

/// 0x134F, 1x system information, version 2, 186 bytes.
Bytes cdmaSystemInformationRecord(const CDMAReport& report, Moment time);

/// 0x119C, 1x searcher: subpackets for its state, RF, the active set and the fingers.
Bytes cdmaSearcherRecord(const CDMAReport& report, Moment time);

/// 0x119D, one 1x traffic frame, in its subpacket; only while there is a call.
Bytes cdmaFrameRecord(const CDMAReport& report, Moment time);

/// 0x1183, EV-DO air link, 50 bytes.
Bytes evdoAirLinkRecord(const CDMAReport& report, Moment time);

/// 0x12B6, pilots of the EV-DO active set; none while 1x has the radio.
Bytes evdoPilotsRecord(const CDMAReport& report, Moment time);

/// 0x108A, C/I of the EV-DO carrier's fingers; all are free while 1x has the radio.
Bytes evdoFingersRecord(const CDMAReport& report, Moment time);

/// 0x1192, packets received on the forward link since the beginning, 241 bytes; not while 1x has the radio.
Bytes evdoForwardCountersRecord(const CDMAReport& report, Moment time);

/// 0x127E, packets sent on the reverse link since the beginning, 1750 bytes; not while 1x has the radio.
Bytes evdoReverseCountersRecord(const CDMAReport& report, Moment time);

} // namespace spectrel
