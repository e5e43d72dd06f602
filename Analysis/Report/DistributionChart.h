#pragma once

#include "Analysis/Cell.h"
#include "Analysis/Report/Axis.h"
#include "Analysis/Report/Report.h"

#include <string>
#include <vector>

namespace spectrel {

/// Appends the distribution curves of a level, one a recording, as a figure of the page with its table: which share of
/// the values was at or below which level.
void appendDistributionChart(const std::vector<ReportedRecording>& recordings, Level level, const LevelAxis& axis,
    const std::string& identifier, std::string& out);

} // namespace spectrel
