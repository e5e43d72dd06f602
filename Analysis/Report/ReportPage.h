#pragma once

#include "Analysis/Report/Report.h"

#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// What every page begins with: by this a file is known as a report.
inline constexpr std::string_view ReportBeginning = "<!DOCTYPE html>\n<!-- Spectrel report -->\n";

/// The report as one HTML page that needs nothing beside itself: no script, nothing fetched. Findings come first;
/// several recordings stand side by side, their charts on the same scales.
std::string reportPage(const std::vector<ReportedRecording>& recordings);

} // namespace spectrel
