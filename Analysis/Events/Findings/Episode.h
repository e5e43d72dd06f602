#pragma once

#include "Analysis/Events/Findings/Finding.h"
#include "Values/Moment.h"

#include <chrono>
#include <optional>
#include <utility>

namespace spectrel {

/// Something that holds for a while and is worth a remark when it has held long enough. It is reported when it is over,
/// with its whole length.
class Episode {
public:
    /// It holds at the moment; the finding is the one of its most striking moment, of which `strength` is the measure.
    void holds(Moment time, Finding finding, double strength)
    {
        if (!_since) {
            _since = time;
            _strength = strength;
            _finding = std::move(finding);
        } else if (strength > _strength) {
            _strength = strength;
            _finding = std::move(finding);
        }
        _latest = time;
    }
    /// It does not hold. The finding, if it has held for the time.
    std::optional<Finding> ends(double seconds)
    {
        if (!_since)
            return std::nullopt;
        _finding.seconds = std::chrono::duration<double>(_latest - *_since).count();
        _since.reset();
        return _finding.seconds >= seconds ? std::optional(std::move(_finding)) : std::nullopt;
    }

private:
    std::optional<Moment> _since; // while it holds
    Moment _latest {};
    double _strength = 0;
    Finding _finding;
};

} // namespace spectrel
