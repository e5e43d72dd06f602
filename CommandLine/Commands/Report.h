#pragma once

#include "Analysis/Events/Thresholds.h"
#include "Platform/Context.h"
#include "Records/Recording.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// What `spectrel report` was asked for.
struct ReportOptions {
    std::vector<std::string> files;
    std::string output; // "-" is standard output
    std::optional<Technology> technology; // where a file does not name it
    Thresholds thresholds; // of findings
};

/// Which recording a file belongs to: its path without the ending, the technology and the number that `record` and
/// `spectrel-telephonyd --write` give to files that go on from one another.
std::string recordingOfFile(std::string_view path);

/// Writes the recordings as one HTML page. Answers the program's exit status.
int writeReport(const ReportOptions& options, const Context& context);

} // namespace spectrel
