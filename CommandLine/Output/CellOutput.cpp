#include "CommandLine/Output/CellOutput.h"

#include "CommandLine/Output/CellJson.h"
#include "CommandLine/Output/CellSummary.h"

namespace spectrel {

CellOutput::CellOutput(
    DisplayState& display, OutputWriter& output, const OutputOptions& options, OperatorNames* operators)
    : _output(output)
    , _options(options)
    , _analysis(display, operators)
{
    _analysis.addListener(*this);
}

CellOutput::~CellOutput()
{
    _analysis.removeListener(*this);
}

void CellOutput::messageAnalysed(const AppliedMessage&, const Journal&, const Analysis&, const AnalysedChanges&) { }

void CellOutput::refreshed(const CellReport& report, const Analysis& analysis)
{
    _line.clear();
    if (_options.format == OutputFormat::Summary) {
        _line = _options.time == TimeForm::RFC3339 ? timeText(report.time, _options.time) : timeOfDay(report.time);
        _line += "  " + summaryOf(report);
    } else {
        appendReportJson(report, analysis, _options.time, _options.withSources, _line);
    }
    _output.printLine(_line);
}

} // namespace spectrel
