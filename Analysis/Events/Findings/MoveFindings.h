#pragma once

#include "Analysis/Analysis.h"
#include "Analysis/Events/Findings/Finding.h"
#include "Analysis/Events/Thresholds.h"

#include <deque>
#include <optional>
#include <vector>

namespace spectrel {

/// Findings in the moves and in the losses of service: ping-pong, overshoot, a long time without service, a late return
/// from an older system.
class MoveFindings {
public:
    MoveFindings(const Analysis& analysis, const Thresholds& thresholds)
        : _analysis(analysis)
        , _thresholds(thresholds)
    {
    }

    std::vector<Finding> eventFound(const Event& event);
    /// The recording ends here.
    std::vector<Finding> finish(Moment time);

private:
    struct Stay {
        Cell cell;
        Moment left {};
    };

    void considerPingPong(const Event& move, std::vector<Finding>& found) const;
    void considerOvershoot(const Event& move, std::vector<Finding>& found) const;
    void considerReturn(const Event& move, std::vector<Finding>& found);
    std::optional<Finding> longWithoutService(double seconds) const;

    const Analysis& _analysis;
    const Thresholds& _thresholds;
    std::deque<Stay> _stays; // on the cells that served before, the latest last
    std::optional<Event> _lost; // while there is no service
    std::optional<Event> _wentDown; // the move to an older system, until the phone is back
};

} // namespace spectrel
