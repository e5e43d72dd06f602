#pragma once

#include "Analysis/Events/Event.h"
#include "Analysis/Events/EvidenceLog.h"
#include "Analysis/Events/MoveTracker.h"

#include <vector>

namespace spectrel {

/// How a move came about by the state that the phone was in, with the leaves that showed it.
struct MoveManner {
    CauseKind kind = CauseKind::Unknown;
    std::vector<Evidence> evidence;
};

MoveManner mannerOf(const EvidenceLog& log, const CellMove& move);

} // namespace spectrel
