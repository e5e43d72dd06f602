#include "Analysis/Events/Findings/Findings.h"

#include <utility>

namespace spectrel {

Findings::Findings(Analysis& analysis, EventFinder& finder, Thresholds thresholds)
    : _analysis(analysis)
    , _finder(finder)
    , _thresholds(thresholds)
    , _moves(analysis, _thresholds)
    , _coverage(analysis, finder.evidence(), _thresholds)
{
    _analysis.addListener(*this);
}

Findings::~Findings()
{
    _analysis.removeListener(*this);
}

void Findings::messageAnalysed(
    const AppliedMessage& message, const Journal&, const Analysis& analysis, const AnalysedChanges&)
{
    if (_looked && message.time < *_looked + Interval)
        return;
    _looked = message.time;
    add(_coverage.consider(analysis.report()));
}

void Findings::eventFound(const Event& event)
{
    if (event.kind != EventKind::Finding)
        add(_moves.eventFound(event));
}

void Findings::finish()
{
    add(_coverage.finish());
    add(_moves.finish(_finder.latestTime()));
}

void Findings::add(std::vector<Finding> findings)
{
    for (Finding& finding : findings) {
        Event event;
        event.n = _finder.latest();
        event.time = _finder.latestTime();
        event.kind = EventKind::Finding;
        event.text = std::move(finding.text);
        event.finding = finding.name;
        event.seconds = finding.seconds;
        event.evidence = std::move(finding.evidence);
        _finder.add(std::move(event));
    }
}

} // namespace spectrel
