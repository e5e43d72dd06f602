#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Report/Report.h"

#include <cstddef>
#include <cstdint>
#include <optional>

namespace spectrel {

/// Gathers what a report shows of a recording, in memory that does not grow with it: the cells and events that are kept
/// have limits, levels are counted, the charts have a number of columns.
class ReportCollector final : public AnalysisListener {
public:
    static constexpr std::size_t MaxCells = 1000;
    static constexpr std::size_t MaxEvents = 1000;
    static constexpr std::size_t MaxFindings = 200;
    /// A serving cell that nothing is heard of for longer no longer counts as serving.
    static constexpr std::chrono::seconds MaxSilence {10};

    /// Fills the recording, which is there for as long as this is.
    explicit ReportCollector(ReportedRecording& recording);

    void messageAnalysed(const AppliedMessage& message, const Journal& journal, const Analysis& analysis,
        const AnalysedChanges& changes) override;
    void refreshed(const CellReport& report, const Analysis& analysis) override;

    void addEvent(ReportedEvent event);
    void addFinding(ReportedEvent finding);

private:
    void follow(Moment time);
    std::optional<std::uint32_t> numberOf(const Cell& cell);
    void addLevels(const Cell& cell, std::uint64_t message);

    ReportedRecording& _recording;
    std::optional<std::uint32_t> _serving; // number of the cell
    std::optional<std::uint32_t> _previous; // the last one that served
};

} // namespace spectrel
