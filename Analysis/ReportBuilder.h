#pragma once

#include "Analysis/CellReport.h"
#include "Values/Value.h"

namespace spectrel {

class DisplayReading;

/// Puts together what the display means now: active cells in its order, neighbours by strength, no cell twice.
void buildReport(DisplayReading& reading, const Value& display, CellReport& report);

} // namespace spectrel
