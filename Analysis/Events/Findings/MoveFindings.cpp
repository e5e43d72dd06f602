#include "Analysis/Events/Findings/MoveFindings.h"

#include <algorithm>
#include <utility>

namespace spectrel {

namespace {

constexpr std::size_t MaxStays = 64;

/// The generation of a system: a phone prefers the later one.
int generationOf(RadioTechnology technology)
{
    switch (technology) {
    case RadioTechnology::GSM:
    case RadioTechnology::CDMA:
        return 2;
    case RadioTechnology::UMTS:
    case RadioTechnology::EVDO:
        return 3;
    case RadioTechnology::LTE:
        return 4;
    }
    return 0;
}

double secondsBetween(Moment from, Moment to)
{
    return std::chrono::duration<double>(to - from).count();
}

} // namespace

std::vector<Finding> MoveFindings::eventFound(const Event& event)
{
    std::vector<Finding> found;
    if (event.kind == EventKind::ServiceLost) {
        _lost = event;
    } else if (event.kind == EventKind::ServiceBack) {
        if (auto finding = longWithoutService(event.seconds.value_or(0)))
            found.push_back(*std::move(finding));
        _lost.reset();
    } else if (event.kind == EventKind::Cell && event.fromCell) {
        considerPingPong(event, found);
        considerOvershoot(event, found);
        considerReturn(event, found);
        _stays.push_back({*event.fromCell, event.time});
        if (_stays.size() > MaxStays)
            _stays.pop_front();
    }
    return found;
}

std::vector<Finding> MoveFindings::finish(Moment time)
{
    std::vector<Finding> found;
    if (_lost) {
        if (auto finding = longWithoutService(secondsBetween(_lost->time, time)))
            found.push_back(*std::move(finding));
    }
    return found;
}

/// From A to B and back to A. In a soft handover both serve all the while: that which of them is stronger changes is
/// nothing to remark.
void MoveFindings::considerPingPong(const Event& move, std::vector<Finding>& found) const
{
    const bool isSoft = move.cause && move.cause->kind == CauseKind::Handover
        && move.toCell->technology != RadioTechnology::LTE && move.toCell->technology != RadioTechnology::GSM;
    if (isSoft || _stays.empty() || !isSameCell(_stays.back().cell, *move.toCell))
        return;
    const double seconds = secondsBetween(_stays.back().left, move.time);
    if (seconds > _thresholds[Threshold::PingPongTime])
        return;
    Finding finding {"ping-pong",
        "Ping-pong: from " + cellText(*move.toCell) + " to " + cellText(*move.fromCell) + " and back after "
            + numberText(seconds) + " s",
        seconds, {}};
    for (const Cell* const cell : {&_stays.back().cell, &*move.fromCell, &*move.toCell})
        speakIdentity(finding.evidence, _analysis, *cell);
    found.push_back(std::move(finding));
}

/// A cell serves again far from where it did: others served in between.
void MoveFindings::considerOvershoot(const Event& move, std::vector<Finding>& found) const
{
    std::vector<const Cell*> between {&*move.fromCell};
    for (auto stay = _stays.rbegin(); stay != _stays.rend(); ++stay) {
        const double seconds = secondsBetween(stay->left, move.time);
        if (seconds > _thresholds[Threshold::OvershootTime])
            return;
        if (isSameCell(stay->cell, *move.toCell)) {
            if (static_cast<double>(between.size()) < _thresholds[Threshold::OvershootSites])
                return;
            Finding finding {"overshoot",
                "Overshoot: " + cellText(*move.toCell) + " serves again after " + std::to_string(between.size())
                    + " other cells",
                seconds, {}};
            speakIdentity(finding.evidence, _analysis, *move.toCell);
            for (const Cell* const cell : between)
                speakIdentity(finding.evidence, _analysis, *cell);
            found.push_back(std::move(finding));
            return;
        }
        const bool isNew =
            std::ranges::none_of(between, [&](const Cell* cell) { return isSameCell(*cell, stay->cell); });
        if (isNew)
            between.push_back(&stay->cell);
    }
}

void MoveFindings::considerReturn(const Event& move, std::vector<Finding>& found)
{
    const int from = generationOf(move.fromCell->technology);
    const int to = generationOf(move.toCell->technology);
    if (to < from && !_wentDown) {
        _wentDown = move;
        return;
    }
    if (!_wentDown || to < generationOf(_wentDown->fromCell->technology))
        return;
    const double seconds = secondsBetween(_wentDown->time, move.time);
    if (seconds >= _thresholds[Threshold::ReturnTime]) {
        Finding finding {"time-to-return",
            "The phone was back on " + cellText(*move.toCell) + " after " + numberText(seconds)
                + " s on an older system",
            seconds, {}};
        speakIdentity(finding.evidence, _analysis, *_wentDown->toCell);
        speakIdentity(finding.evidence, _analysis, *move.toCell);
        found.push_back(std::move(finding));
    }
    _wentDown.reset();
}

std::optional<Finding> MoveFindings::longWithoutService(double seconds) const
{
    if (!_lost || seconds < _thresholds[Threshold::NoServiceTime])
        return std::nullopt;
    Finding finding {"no-service", "Without service for " + numberText(seconds) + " s", seconds, {}};
    if (_lost->cell) {
        finding.text += " after " + cellText(*_lost->cell);
        speakIdentity(finding.evidence, _analysis, *_lost->cell);
    }
    return finding;
}

} // namespace spectrel
