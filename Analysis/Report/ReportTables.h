#pragma once

#include "Analysis/Report/Report.h"

#include <string>
#include <vector>

namespace spectrel {

/// The tables of a report, each as elements of the page.
void appendFindings(const ReportedRecording& recording, std::string& out);
/// What was recorded, a column a recording.
void appendOverview(const std::vector<ReportedRecording>& recordings, std::string& out);
/// The cells that served, by the time that they did.
void appendCells(const ReportedRecording& recording, std::string& out);
void appendEvents(const ReportedRecording& recording, std::string& out);

} // namespace spectrel
