#pragma once

#include "Platform/SystemLog.h"
#include "Records/RecordView.h"
#include "Values/Dictionary.h"
#include "Values/Value.h"

/// The decoders of the CDMA2000 log records. Each takes a whole record, checks its length, and shows texts under fixed
/// variable names; one that it refuses is logged and changes nothing. Offsets count from the record's first byte.
namespace spectrel {

/// 0x108A: C/I of the rake fingers.
void decodeFingers(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);

/// 0x1183: EV-DO air link, in short.
void decodeAirLinkSummary(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);

/// 0x12B6: pilots of the EV-DO active set.
void decodeActiveSetPilots(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);

/// 0x119C: 1x searcher, RF and active set. Shows the frame-error rate once more, marked old, when traffic has ended.
void decodeSearcher(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);

/// 0x119D: one 1x traffic frame. The state's "TrafficFER" (0 to 1) is the average so far.
void decodeFrameErrors(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);

/// 0x1192 and 0x127E: EV-DO data sent since the session began, on the forward and on the reverse link. The rate is the
/// difference to the record before, which the state keeps, in kbps of 1024 bits; both pairs go into "ExtraInfo".
void decodeForwardLinkData(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);
void decodeReverseLinkData(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);

/// 0x134F: 1x system information.
void decodeSystemInformation(SystemLog& log, RecordView record, Dictionary& state, const Value& lookup);

} // namespace spectrel
