#pragma once

#include "Platform/Bytes.h"
#include "Platform/Clock.h"

namespace spectrel {

struct LTECell;

/// 0xB0C2, serving cell configuration, 38 bytes.
Bytes lteServingCellRecord(const LTECell& cell, Moment time);

/// 0xB0C1, broadcast information, 22 bytes: the transmit antennas.
Bytes lteAntennasRecord(const LTECell& cell, Moment time);

} // namespace spectrel
