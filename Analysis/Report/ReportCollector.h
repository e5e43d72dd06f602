#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/EventFinder.h"
#include "Analysis/Events/Findings/Findings.h"
#include "Analysis/Events/Thresholds.h"
#include "Analysis/OperatorNames.h"
#include "Analysis/Report/Report.h"

#include <cstddef>
#include <cstdint>
#include <optional>

namespace spectrel {

/// Analyses a display and gathers what a report shows of the recording, in memory that does not grow with it: the cells
/// and events that are kept have limits, levels are counted, the charts have a number of columns.
class ReportCollector final : private AnalysisListener, private EventListener {
public:
    static constexpr std::size_t MaxCells = 1000;
    static constexpr std::size_t MaxEvents = 1000;
    static constexpr std::size_t MaxFindings = 200;
    /// A serving cell that nothing is heard of for longer no longer counts as serving.
    static constexpr std::chrono::seconds MaxSilence {10};

    /// Fills the recording from the display's messages on. All are there for as long as this is; the names may be null.
    ReportCollector(
        DisplayState& display, ReportedRecording& recording, const Thresholds& thresholds, OperatorNames* operators);
    ~ReportCollector() override;
    ReportCollector(const ReportCollector&) = delete;
    ReportCollector& operator=(const ReportCollector&) = delete;

    /// A note that somebody made at a moment.
    void addBookmark(Moment time, const std::string& note);
    /// No more messages come.
    void finish();

private:
    void messageAnalysed(const AppliedMessage& message, const Journal& journal, const Analysis& analysis,
        const AnalysedChanges& changes) override;
    void refreshed(const CellReport& report, const Analysis& analysis) override;

    void eventFound(const Event& event) override;

    void follow(Moment time);
    std::optional<std::uint32_t> numberOf(const Cell& cell);
    void addLevels(const Cell& cell, std::uint64_t message);

    ReportedRecording& _recording;
    Analysis _analysis;
    EventFinder _finder;
    Findings _findings;
    std::optional<std::uint32_t> _serving; // number of the cell
    std::optional<std::uint32_t> _previous; // the last one that served
};

} // namespace spectrel
