#pragma once

#include "LogGenerator/Template/RecordSection.h"

namespace spectrel {

// The sections that keep their place on the screen and log a line; no record fills them.

using CellChangeCounters = PlainSection<"Cell Change Counters", "CellChangeCounters">;
using CodingScheme = PlainSection<"Coding Scheme", "CellChangeCounters">; // not its own name: kept on purpose
using NonRankedGSMSet = PlainSection<"Non-Ranked GSM Set", "NonRankedGSMSet">;
using NonRankedUMTSSet = PlainSection<"Non-Ranked UMTS Set", "NonRankedUMTSSet">;
using UMTSRRMeasurement = PlainSection<"UMTS RR Measurement", "UMTSRRMeasurement">;

} // namespace spectrel
