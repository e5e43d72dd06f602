#pragma once

#include "Analysis/Analysis.h"
#include "CommandLine/Output/OutputWriter.h"

namespace spectrel {

/// Prints what the display means, one line at each refresh, in the Cells or Summary format.
class CellOutput final : private AnalysisListener {
public:
    /// All of them are there for as long as this is; the names may be null.
    CellOutput(DisplayState& display, OutputWriter& output, const OutputOptions& options, OperatorNames* operators);
    ~CellOutput() override;
    CellOutput(const CellOutput&) = delete;
    CellOutput& operator=(const CellOutput&) = delete;

    void refresh(Moment time)
    {
        _analysis.refresh(time);
    }

private:
    void messageAnalysed(const AppliedMessage& message, const Journal& journal, const Analysis& analysis,
        const AnalysedChanges& changes) override;
    void refreshed(const CellReport& report, const Analysis& analysis) override;

    OutputWriter& _output;
    const OutputOptions& _options;
    Analysis _analysis;
    std::string _line;
};

} // namespace spectrel
