#include "Telephony/Simulator/JourneyBaseband.h"

#include <algorithm>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::size_t UTRANPart = 1;
constexpr std::size_t GSMPart = 2;

constexpr auto TimeUp = 5s;
constexpr auto TimeDown = 3s; // Treselection
constexpr auto TimeToRedirect = 1s;
constexpr double ThreshServingLow = 10; // dB: below it the serving cell is weak...
constexpr double ThreshRedirect = 4; // ... and below it a connection is about to break
constexpr double ThreshLow = 6; // dB, of a cell below

} // namespace

JourneyBaseband::JourneyBaseband(Technology first, std::uint32_t seed)
    : _parts {makeLTEPart(seed), makeUTRANPart(seed), makeGSMPart(seed)}
{
    const auto begin = std::ranges::find(_parts, first, [](const auto& part) { return part->technology(); });
    _active = static_cast<std::size_t>(begin - _parts.begin());
    for (const auto& part : _parts)
        part->leave();
    active().arrive(first, MoveKind::Reselection);
    _moves.push_back({std::nullopt, active().servingCell(), std::nullopt});
}

void JourneyBaseband::advance(Moment now, const Emit& emit)
{
    active().setOthers(_parts[UTRANPart]->coverage(), _parts[GSMPart]->coverage());
    for (const auto& part : _parts) {
        if (part != _parts[_active])
            part->advanceAway();
    }
    active().advance(now, emit);
    _moves.assign(active().moves().begin(), active().moves().end());
    const auto next = choice();
    _choiceFor = next && next == _choice ? _choiceFor + Step : Step;
    _choice = next;
    if (_choice && _choiceFor >= _choice->time && active().isSettled())
        moveTo(*_choice);
}

std::optional<JourneyBaseband::Choice> JourneyBaseband::choice() const
{
    for (std::size_t above = 0; above < _active; ++above) {
        if (!active().isConnected() && _parts[above]->coverage().isPreferable)
            return Choice {above, byReselection(ReselectionRule::HigherPriority), TimeUp};
    }
    return choiceDown();
}

std::optional<JourneyBaseband::Choice> JourneyBaseband::choiceDown() const
{
    const bool isConnected = active().isConnected();
    const double margin = active().servingMargin();
    if (margin >= (isConnected ? ThreshRedirect : ThreshServingLow))
        return std::nullopt;
    for (std::size_t below = _active + 1; below < _parts.size(); ++below) {
        if (_parts[below]->coverage().margin <= ThreshLow)
            continue;
        if (isConnected)
            return Choice {below, ByRedirection, TimeToRedirect};
        const auto rule = margin < 0 ? ReselectionRule::NotSuitable : ReselectionRule::LowerPriority;
        return Choice {below, byReselection(rule), TimeDown};
    }
    return std::nullopt;
}

void JourneyBaseband::moveTo(const Choice& choice)
{
    const CellName from = active().servingCell();
    const Technology before = technology();
    active().leave();
    _active = choice.part;
    active().arrive(before, choice.cause.kind);
    _moves.push_back({from, active().servingCell(), choice.cause});
    _choice.reset();
}

} // namespace spectrel
