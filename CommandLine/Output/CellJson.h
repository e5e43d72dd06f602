#pragma once

#include "Analysis/Analysis.h"
#include "CommandLine/Output/TimeForm.h"

#include <optional>
#include <string>

namespace spectrel {

/// What is told of a cell beside the cell itself.
struct CellDetails {
    std::optional<Moment> now {}; // gives the cell's age
    const Analysis* sources = nullptr; // gives the paths that the values come from
};

/// Appends a cell as one JSON object on one line, without what is not known.
void appendCellJson(const Cell& cell, const CellDetails& details, std::string& out);

/// Appends a report as one JSON object on one line, without a line end. `sources`: with the paths that values come
/// from.
void appendReportJson(
    const CellReport& report, const Analysis& analysis, TimeForm form, bool withSources, std::string& out);

} // namespace spectrel
