#include "Analysis/Events/Causes/CauseFinder.h"

#include "Analysis/Events/Causes/PhoneMode.h"
#include "Analysis/Events/Causes/Rules.h"

#include <iterator>
#include <utility>

namespace spectrel {

namespace {

FittingRule ruleOf(const EvidenceLog& log, const CellMove& move, const OriginPath& pathOf)
{
    const RadioTechnology from = move.from->technology;
    const RadioTechnology to = move.to.technology;
    if (from == RadioTechnology::LTE)
        return lteRule(log, move);
    if (from == RadioTechnology::GSM && to == RadioTechnology::UMTS)
        return gsmToUMTSRule(log, move);
    if (from == RadioTechnology::GSM && to == from && !log.samples(EvidenceSection::GSMServing).empty())
        return gsmRule(log, move);
    if (from == RadioTechnology::UMTS && !log.samples(EvidenceSection::UMTSState).empty())
        return umtsRule(log, move);
    return from == to ? strengthRule(move, pathOf) : FittingRule();
}

} // namespace

EventCause findCause(const EvidenceLog& log, const CellMove& move, const OriginPath& pathOf)
{
    if (move.isAfterLoss)
        return {CauseKind::ServiceLost, CauseRule::Unknown, "there was no service in between", {}};
    MoveManner manner = mannerOf(log, move);
    EventCause cause {manner.kind, CauseRule::Unknown, "", std::move(manner.evidence)};
    if (cause.kind != CauseKind::Reselection)
        return cause;
    FittingRule fitting = ruleOf(log, move, pathOf);
    cause.rule = fitting.rule;
    cause.text = std::move(fitting.text);
    cause.evidence.insert(cause.evidence.end(), std::make_move_iterator(fitting.evidence.begin()),
        std::make_move_iterator(fitting.evidence.end()));
    return cause;
}

} // namespace spectrel
