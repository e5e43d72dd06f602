#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/EvidenceLog.h"
#include "Analysis/Events/Findings/Episode.h"
#include "Analysis/Events/Findings/Finding.h"
#include "Analysis/Events/Thresholds.h"

#include <optional>
#include <vector>

namespace spectrel {

/// Findings in what the phone hears: holes, better neighbours, pilot pollution, missing neighbours. Each is reported
/// when it is over.
class CoverageFindings {
public:
    CoverageFindings(const Analysis& analysis, const EvidenceLog& log, const Thresholds& thresholds)
        : _analysis(analysis)
        , _log(log)
        , _thresholds(thresholds)
    {
    }

    /// Every two seconds or so.
    std::vector<Finding> consider(const CellReport& report);
    /// The recording ends here.
    std::vector<Finding> finish();

private:
    void considerHole(const CellReport& report);
    void considerBetterNeighbour(const CellReport& report);
    void considerPollution(const CellReport& report);
    void considerMissingNeighbour(const CellReport& report);
    std::string whatKeptIt(const CellReport& report, const Cell& neighbour) const;
    void end(Episode& episode, Threshold time);

    const Analysis& _analysis;
    const EvidenceLog& _log;
    const Thresholds& _thresholds;
    Episode _hole;
    Episode _better;
    Episode _pollution;
    Episode _missing;
    std::optional<Cell> _serving; // of the episodes
    std::optional<Cell> _betterCell;
    std::vector<Finding> _found;
};

} // namespace spectrel
