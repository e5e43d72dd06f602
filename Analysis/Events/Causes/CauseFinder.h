#pragma once

#include "Analysis/Events/Event.h"
#include "Analysis/Events/EvidenceLog.h"
#include "Analysis/Events/MoveTracker.h"

#include <functional>

namespace spectrel {

/// The path of a cell value's origin.
using OriginPath = std::function<std::string(const Origin&)>;

/// Why the phone moved, by what the display showed until the move was settled; only of a move from one cell to another.
///
/// The kind follows from the state that the phone was in, the rule of a reselection from what had been measured. What
/// the evidence does not decide is `Unknown`.
EventCause findCause(const EvidenceLog& log, const CellMove& move, const OriginPath& pathOf);

} // namespace spectrel
