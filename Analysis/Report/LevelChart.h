#pragma once

#include "Analysis/Cell.h"
#include "Analysis/Report/Axis.h"
#include "Analysis/Report/Report.h"

#include <cstdint>
#include <string>

namespace spectrel {

/// Charts beside each other are drawn narrower, so that their letters stay as large as the page's.
enum class ChartWidth : std::uint8_t { Whole, Half };

/// Appends the chart of a level over a recording's time, as a figure of the page: an SVG coloured by serving cell, with
/// the events marked, and the same numbers as a table. The identifier is unique in the page.
void appendLevelChart(const ReportedRecording& recording, Level level, const LevelAxis& axis, ChartWidth width,
    const std::string& identifier, std::string& out);

/// The scale of a level that all recordings share; of a level that none has, any.
LevelAxis levelAxis(const std::vector<ReportedRecording>& recordings, Level level);

} // namespace spectrel
