#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/EventFinder.h"
#include "Analysis/Events/Findings/CoverageFindings.h"
#include "Analysis/Events/Findings/MoveFindings.h"
#include "Analysis/Events/Thresholds.h"

#include <chrono>
#include <optional>
#include <vector>

namespace spectrel {

/// Remarks what an expert would, and adds it to the events.
class Findings final : public AnalysisListener {
public:
    static constexpr std::chrono::seconds Interval {2}; // between two looks at what the phone hears

    /// Listens to the analysis from now on, behind the finder. Both are there for as long as this is.
    Findings(Analysis& analysis, EventFinder& finder, Thresholds thresholds);
    ~Findings() override;
    Findings(const Findings&) = delete;
    Findings& operator=(const Findings&) = delete;

    void messageAnalysed(const AppliedMessage& message, const Journal& journal, const Analysis& analysis,
        const AnalysedChanges& changes) override;
    void refreshed(const CellReport&, const Analysis&) override { }
    /// The finder has found one.
    void eventFound(const Event& event);
    /// No more messages come. Before the finder's own `finish` nothing that it waits for is known; so this is called
    /// behind it.
    void finish();

private:
    void add(std::vector<Finding> findings);

    Analysis& _analysis;
    EventFinder& _finder;
    Thresholds _thresholds;
    MoveFindings _moves;
    CoverageFindings _coverage;
    std::optional<Moment> _looked;
};

} // namespace spectrel
