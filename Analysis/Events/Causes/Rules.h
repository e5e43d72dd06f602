#pragma once

#include "Analysis/Events/Causes/CauseFinder.h"

#include <string>
#include <vector>

namespace spectrel {

/// A rule of reselection that fits what was measured.
struct FittingRule {
    CauseRule rule = CauseRule::Unknown;
    std::string text;
    std::vector<Evidence> evidence;
};

/// From an LTE cell (3GPP TS 36.304, 5.2.4).
FittingRule lteRule(const EvidenceLog& log, const CellMove& move);

/// Among GSM cells (3GPP TS 45.008, 6.6.2).
FittingRule gsmRule(const EvidenceLog& log, const CellMove& move);

/// Among UMTS cells, and from UMTS to GSM (3GPP TS 25.304, 5.2.6.1.4).
FittingRule umtsRule(const EvidenceLog& log, const CellMove& move);

/// From GSM to UMTS (3GPP TS 45.008, 6.6.5).
FittingRule gsmToUMTSRule(const EvidenceLog& log, const CellMove& move);

/// By the levels of both cells alone: before the move and after it.
FittingRule strengthRule(const CellMove& move, const OriginPath& pathOf);

} // namespace spectrel
