#pragma once

#include "Analysis/Analysis.h"
#include "CommandLine/Output/OutputWriter.h"

#include <optional>
#include <string>

namespace spectrel {

/// Prints the Table format: CSV with `time` and the columns that were asked for, one row at each refresh.
class TableOutput {
public:
    /// Prints the header. All of them are there for as long as this is; the names may be null.
    TableOutput(DisplayState& display, OutputWriter& output, const OutputOptions& options, OperatorNames* operators);

    void refresh(Moment time);

private:
    void print();

    DisplayState& _display;
    OutputWriter& _output;
    const OutputOptions& _options;
    std::optional<Analysis> _analysis; // where the serving cell is asked for
    std::string _line;
};

} // namespace spectrel
