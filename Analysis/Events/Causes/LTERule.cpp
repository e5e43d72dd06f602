#include "Analysis/Events/Causes/Rules.h"
#include "Analysis/Events/MoveText.h"

#include <algorithm>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

/// What was measured longer ago does not speak for a move: two idle cycles of the longest paging cycle, 2.56 s.
constexpr auto Recent = 5s;
/// Candidates and carriers are reported in turn, one a cycle.
constexpr auto Turn = 10s;
/// Cycles with Srxlev below 0 after which the phone looks for any suitable cell (3GPP TS 36.133, 4.2.2.1: N_serv is 4
/// at most). The cycle of the move itself is not shown any more.
constexpr double CyclesUntilLost = 3;

/// The serving cell's idle measurement before the move.
const EvidenceSample* servingBefore(const EvidenceLog& log, const CellMove& move)
{
    const EvidenceSample* const sample = log.latestBefore(EvidenceSection::LTEServing, move.n);
    const bool isFrom = sample && sample->number("E-ARFCN") == move.from->channel
        && sample->number("Physical Cell ID") == move.from->id;
    return isFrom && sample->time >= move.time - Recent ? sample : nullptr;
}

bool isTarget(const EvidenceSample& candidate, const Cell& to)
{
    const std::string& technology = candidate.text("Candidate RAT Type");
    if (to.technology == RadioTechnology::LTE)
        return technology == "LTE" && candidate.number("E ARFCN") == to.channel && candidate.number("Cell ID") == to.id;
    if (to.technology == RadioTechnology::UMTS)
        return technology == "UTRAN" && candidate.number("U ARFCN") == to.channel && candidate.number("PSC") == to.id;
    if (to.technology == RadioTechnology::GSM)
        return technology == "GERAN" && candidate.number("ARFCN") == to.channel && candidate.number("BSIC ID") == to.id;
    return false;
}

/// The new cell as a candidate before the move.
struct Candidacy {
    const EvidenceSample* latest = nullptr;
    Moment since {}; // of the unbroken row of reports up to the move
};

Candidacy candidacyOf(const EvidenceLog& log, const CellMove& move)
{
    Candidacy candidacy;
    const auto& samples = log.samples(EvidenceSection::LTECandidates);
    for (auto sample = samples.rbegin(); sample != samples.rend(); ++sample) {
        if (sample->n >= move.n || !isTarget(*sample, move.to))
            continue;
        if ((candidacy.latest ? candidacy.since : move.time) - sample->time > Turn)
            break;
        if (!candidacy.latest)
            candidacy.latest = &*sample;
        candidacy.since = sample->time;
    }
    return candidacy;
}

/// The new cell as an LTE neighbour before the move.
const EvidenceSample* neighbourBefore(const EvidenceLog& log, const CellMove& move)
{
    const auto& samples = log.samples(EvidenceSection::LTENeighbours);
    for (auto sample = samples.rbegin(); sample != samples.rend(); ++sample) {
        if (sample->n >= move.n || sample->number("Physical Cell ID") != move.to.id)
            continue;
        if (sample->time < move.time - Turn)
            break;
        const EvidenceSample* const carrier = log.latestWith(EvidenceSection::LTECarrier, "E-ARFCN", sample->n);
        if (carrier && carrier->number("E-ARFCN") == move.to.channel)
            return &*sample;
    }
    return nullptr;
}

/// The priority of the new cell's carrier as a candidate, or as the new cell itself reports it.
const EvidenceSample* priorityOfTarget(const EvidenceLog& log, const CellMove& move, const Candidacy& candidacy)
{
    if (candidacy.latest && candidacy.latest->number("Candidate Priority"))
        return candidacy.latest;
    if (move.to.technology != RadioTechnology::LTE)
        return nullptr;
    const auto& samples = log.samples(EvidenceSection::LTEServing);
    const auto found = std::ranges::find_if(samples, [&](const EvidenceSample& each) {
        return each.n >= move.n && each.number("E-ARFCN") == move.to.channel
            && each.number("Serving Layer Priority").has_value();
    });
    return found == samples.end() ? nullptr : &*found;
}

std::string_view priorityKey(const EvidenceSample& sample)
{
    return sample.section == EvidenceSection::LTECandidates ? "Candidate Priority" : "Serving Layer Priority";
}

/// Everything that was measured for the decision.
class Judgement {
public:
    Judgement(const EvidenceLog& log, const CellMove& move)
        : _move(move)
        , _serving(servingBefore(log, move))
        , _candidacy(candidacyOf(log, move))
        , _neighbour(neighbourBefore(log, move))
        , _priority(priorityOfTarget(log, move, _candidacy))
    {
    }

    FittingRule rule()
    {
        if (!_serving || !_serving->number("Srxlev"))
            return {};
        for (const std::string_view key : {"Srxlev", "Average RSRP", "Average RSRQ", "S Intra Search",
                 "S Non Intra Search", "Serving Layer Priority"})
            speak(_serving, key);
        decide();
        if (_rule.rule != CauseRule::Unknown)
            addHeldTime();
        return std::move(_rule);
    }

private:
    void speak(const EvidenceSample* sample, std::string_view key)
    {
        if (sample && !sample->text(key).empty())
            _rule.evidence.push_back(sample->evidence(key));
    }

    void decide()
    {
        const double srxlev = *_serving->number("Srxlev");
        constexpr std::string_view Cycles = "Num of Consecutive DRX Cycles of S < 0";
        if (srxlev < 0 && _serving->number(Cycles).value_or(0) >= CyclesUntilLost) {
            speak(_serving, Cycles);
            return tell(CauseRule::NotSuitable,
                "the cell was no longer suitable (Srxlev " + numberText(srxlev) + " dB for "
                    + numberText(*_serving->number(Cycles)) + " cycles)");
        }
        speak(_neighbour, "Average RSRP");
        speak(_neighbour, "Srxlev");
        if (_move.to.technology == RadioTechnology::LTE && _move.to.channel == _move.from->channel)
            return rank();
        comparePriorities(srxlev);
    }

    /// On one carrier the stronger cell is chosen, whatever the priorities (5.2.4.6).
    void rank()
    {
        const auto serving = _serving->number("Average RSRP");
        const auto other = _neighbour ? _neighbour->number("Average RSRP") : std::nullopt;
        if (serving && other && *other > *serving)
            return tell(CauseRule::EqualPriority,
                "ranked above it on the same carrier (RSRP " + numberText(*other) + " over " + numberText(*serving)
                    + " dBm)");
        if (_candidacy.latest && !other) {
            speak(_candidacy.latest, "Cell ID");
            tell(CauseRule::EqualPriority, "ranked above it on the same carrier");
        }
    }

    void comparePriorities(double srxlev)
    {
        const auto from = _serving->number("Serving Layer Priority");
        const auto to = _priority ? _priority->number(priorityKey(*_priority)) : std::nullopt;
        if (!from || !to)
            return;
        speak(_priority, priorityKey(*_priority));
        const std::string priorities = numberText(*to) + " against " + numberText(*from);
        if (*to > *from)
            return tell(CauseRule::HigherPriority, "its carrier has a higher priority (" + priorities + ")");
        if (*to == *from)
            return tell(CauseRule::EqualPriority, "ranked above it at equal priority (" + priorities + ")");
        // The phone does not even look for lower priorities above the search threshold.
        const auto search = _serving->number("S Non Intra Search");
        if (!search || srxlev <= *search)
            tell(CauseRule::LowerPriority,
                "the cell had become weak (Srxlev " + numberText(srxlev) + " dB), and the other's carrier has a lower "
                    + "priority (" + priorities + ")");
    }

    void tell(CauseRule rule, std::string text)
    {
        _rule.rule = rule;
        _rule.text = std::move(text);
    }

    void addHeldTime()
    {
        if (_rule.rule == CauseRule::NotSuitable || !_candidacy.latest)
            return;
        const double held = std::chrono::duration<double>(_move.time - _candidacy.since).count();
        _rule.text += ", a candidate for " + numberText(held) + " s";
    }

    const CellMove& _move;
    const EvidenceSample* _serving;
    Candidacy _candidacy;
    const EvidenceSample* _neighbour;
    const EvidenceSample* _priority;
    FittingRule _rule;
};

} // namespace

FittingRule lteRule(const EvidenceLog& log, const CellMove& move)
{
    return Judgement(log, move).rule();
}

} // namespace spectrel
