#include "Analysis/Events/Causes/Rules.h"
#include "Analysis/Events/MoveText.h"

#include <chrono>
#include <optional>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

/// What was measured longer ago does not speak for a move. GSM neighbours of a UMTS cell are shown every 5 s.
constexpr auto Recent = 6s;

/// A criterion of 16 bits as the display shows it, without its sign (C1, C2).
std::optional<double> signed16(std::optional<double> shown)
{
    return shown && *shown >= 0x8000 ? *shown - 0x10000 : shown;
}

/// The latest sample before the move, not too old, in which `key` has the number and `wanted` has one at all.
const EvidenceSample* recentWith(const EvidenceLog& log, EvidenceSection section, const CellMove& move,
    std::string_view key, std::optional<std::uint32_t> number, std::string_view wanted)
{
    const auto& samples = log.samples(section);
    for (auto sample = samples.rbegin(); sample != samples.rend(); ++sample) {
        if (sample->n >= move.n)
            continue;
        if (sample->time < move.time - Recent)
            break;
        if (number && sample->number(key) == number && sample->number(wanted))
            return &*sample;
    }
    return nullptr;
}

std::string over(const char* name, double one, double other, const char* unit)
{
    return std::string(name) + " " + numberText(one) + " over " + numberText(other) + unit;
}

std::string heldText(const CellMove& move, Moment since)
{
    return ", for " + numberText(std::chrono::duration<double>(move.time - since).count()) + " s";
}

/// C2 is C1 and an offset that each cell broadcasts for itself: its own measurement shows it once it serves.
double offsetOf(const EvidenceLog& log, const CellMove& move)
{
    for (const EvidenceSample& sample : log.samples(EvidenceSection::GSMServing)) {
        const auto c1 = signed16(sample.number("C1 Value"));
        const auto c2 = signed16(sample.number("C2 Value"));
        if (sample.n >= move.n && c1 && c2)
            return *c2 - *c1;
    }
    return 0;
}

/// Since when, without a break, the neighbour's C2 has been above that of the cell it was measured beside.
Moment aboveSince(const EvidenceLog& log, const CellMove& move, double offset)
{
    Moment since = move.time;
    const auto& samples = log.samples(EvidenceSection::GSMNeighbours);
    for (auto sample = samples.rbegin(); sample != samples.rend(); ++sample) {
        const auto c1 = signed16(sample->number("C1 Value"));
        if (sample->n >= move.n || sample->number("ARFCN") != move.to.channel || !c1)
            continue;
        const EvidenceSample* const serving = log.latestWith(EvidenceSection::GSMServing, "C2 Value", sample->n);
        if (!serving || since - sample->time > Recent || *c1 + offset <= *signed16(serving->number("C2 Value")))
            break;
        since = sample->time;
    }
    return since;
}

} // namespace

FittingRule gsmRule(const EvidenceLog& log, const CellMove& move)
{
    const EvidenceSample* const serving =
        move.n > 0 ? log.latestWith(EvidenceSection::GSMServing, "C2 Value", move.n - 1) : nullptr;
    if (!serving || serving->time < move.time - Recent)
        return {};
    FittingRule fitting;
    fitting.evidence = {serving->evidence("C1 Value"), serving->evidence("C2 Value")};
    const double servingC1 = *signed16(serving->number("C1 Value"));
    const double servingC2 = *signed16(serving->number("C2 Value"));
    const EvidenceSample* const other =
        recentWith(log, EvidenceSection::GSMNeighbours, move, "ARFCN", move.to.channel, "C1 Value");
    const double offset = offsetOf(log, move);
    const double c2 = other ? *signed16(other->number("C1 Value")) + offset : servingC2;
    if (other)
        fitting.evidence.push_back(other->evidence("C1 Value"));
    const bool isRankedAbove = c2 > servingC2;
    const bool isUnsuitable = servingC1 < 0;
    if (isUnsuitable && !isRankedAbove) {
        fitting.rule = CauseRule::NotSuitable;
        fitting.text = "the cell was no longer suitable (C1 " + numberText(servingC1) + " dB)";
    } else if (isRankedAbove && !isUnsuitable) {
        fitting.rule = CauseRule::EqualPriority;
        fitting.text = over("C2", c2, servingC2, " dB") + heldText(move, aboveSince(log, move, offset));
    }
    return fitting;
}

namespace {

/// Q_qualmin is at least -24 dB and hardly ever above -16 dB, Q_rxlevmin hardly ever above -105 dBm (3GPP TS 25.331,
/// 10.3.2.3); the display has neither. Between these and what is surely not suitable nothing is decided.
constexpr double SurelySuitableEcNo = -16;
constexpr double SurelyUnsuitableEcNo = -24;
constexpr double SurelySuitableRscp = -105;

const EvidenceSample* servingUMTS(const EvidenceLog& log, const CellMove& move)
{
    return recentWith(log, EvidenceSection::UMTSActive, move, "Scrambling Code", move.from->id, "RSCP");
}

FittingRule umtsToUMTS(const EvidenceLog& log, const CellMove& move)
{
    const EvidenceSample* const serving = servingUMTS(log, move);
    const EvidenceSample* const other =
        recentWith(log, EvidenceSection::UMTSRanking, move, "Scrambling Code", move.to.id, "RSCP");
    if (!serving || !other)
        return {};
    FittingRule fitting;
    fitting.evidence = {serving->evidence("RSCP"), serving->evidence("Energy Per Chip"), other->evidence("RSCP")};
    if (!other->text("Ranking Value").empty())
        fitting.evidence.push_back(other->evidence("Ranking Value"));
    const double before = *serving->number("RSCP");
    if (*other->number("RSCP") > before) {
        fitting.rule = CauseRule::EqualPriority;
        fitting.text = "ranked above it (" + over("RSCP", *other->number("RSCP"), before, " dBm") + ")";
    }
    return fitting;
}

FittingRule umtsToGSM(const EvidenceLog& log, const CellMove& move)
{
    const EvidenceSample* const serving = servingUMTS(log, move);
    if (!serving || !serving->number("Energy Per Chip"))
        return {};
    FittingRule fitting;
    fitting.evidence = {serving->evidence("RSCP"), serving->evidence("Energy Per Chip")};
    const double ecNo = *serving->number("Energy Per Chip");
    const double rscp = *serving->number("RSCP");
    const EvidenceSample* const other =
        recentWith(log, EvidenceSection::GSMRanking, move, "ARFCN", move.to.channel, "Ranking Value");
    if (other)
        fitting.evidence.push_back(other->evidence("Ranking Value"));
    if (ecNo <= SurelyUnsuitableEcNo) {
        fitting.rule = CauseRule::NotSuitable;
        fitting.text = "the cell was no longer suitable (Ec/No " + numberText(ecNo) + " dB)";
    } else if (ecNo >= SurelySuitableEcNo && rscp >= SurelySuitableRscp && other
        && *other->number("Ranking Value") > rscp) {
        fitting.rule = CauseRule::EqualPriority;
        fitting.text = "ranked above it (" + over("rank", *other->number("Ranking Value"), rscp, " dBm") + ")";
    }
    return fitting;
}

} // namespace

FittingRule umtsRule(const EvidenceLog& log, const CellMove& move)
{
    if (move.to.technology == RadioTechnology::UMTS)
        return umtsToUMTS(log, move);
    return move.to.technology == RadioTechnology::GSM ? umtsToGSM(log, move) : FittingRule();
}

FittingRule gsmToUMTSRule(const EvidenceLog& log, const CellMove& move)
{
    const EvidenceSample* const serving =
        move.n > 0 ? log.latestWith(EvidenceSection::GSMServing, "C1 Value", move.n - 1) : nullptr;
    const EvidenceSample* const other =
        recentWith(log, EvidenceSection::UMTSRanking, move, "Scrambling Code", move.to.id, "Energy Per Chip");
    if (!serving || !other)
        return {};
    FittingRule fitting;
    fitting.evidence = {serving->evidence("C1 Value"), other->evidence("RSCP"), other->evidence("Energy Per Chip")};
    // Without priorities there is but one rule to UMTS while the GSM cell is suitable: a cell that is good enough, and
    // strong enough beside the GSM cells.
    if (*signed16(serving->number("C1 Value")) >= 0) {
        fitting.rule = CauseRule::EqualPriority;
        fitting.text =
            "a UMTS cell good enough beside GSM (Ec/No " + numberText(*other->number("Energy Per Chip")) + " dB)";
    }
    return fitting;
}

FittingRule strengthRule(const CellMove& move, const OriginPath& pathOf)
{
    const auto level = move.to.strengthLevel();
    if (!level || !move.from->level(*level))
        return {};
    const double before = *move.from->level(*level);
    const double after = *move.to.level(*level);
    FittingRule fitting;
    const auto speak = [&](const Cell& cell, double value) {
        const Origin& origin = cell.origin(cellKeyOf(*level));
        if (origin)
            fitting.evidence.push_back({pathOf(origin), numberText(value), origin.time});
    };
    speak(*move.from, before);
    speak(move.to, after);
    if (after > before) {
        fitting.rule = CauseRule::EqualPriority;
        fitting.text = "the stronger cell (" + over(std::string(levelName(*level)).c_str(), after, before, " ")
            + std::string(levelUnit(*level)) + ")";
    }
    return fitting;
}

} // namespace spectrel
