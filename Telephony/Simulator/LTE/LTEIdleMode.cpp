#include "Telephony/Simulator/LTE/LTEIdleMode.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr int MaxUETransmitPower = 23; // dBm, power class 3 (3GPP TS 36.101, table 6.2.2-1)
constexpr double Audible = -24; // dB of RSRQ
constexpr unsigned MaxCycleCount = 63; // the record's field has six bits
constexpr std::size_t MaxNeighbours = 32;

/// The second antenna's path is a little longer.
constexpr std::uint32_t SecondAntennaDelay = 2; // samples

LTEIdleNeighbour neighbourReport(const LTECell& cell)
{
    LTEIdleNeighbour report;
    report.physicalCellId = cell.physicalCellId;
    report.measured = cell.measured;
    report.average = cell.average;
    report.srxlev = cell.srxlev();
    report.frequencyOffset = cell.frequencyOffset;
    report.antennas[0] = {cell.frameOffset, cell.sampleOffset};
    report.antennas[1] = {cell.frameOffset, cell.sampleOffset + SecondAntennaDelay};
    return report;
}

} // namespace

LTEIdleMode::LTEIdleMode(const LTERoad& road)
    : _road(road)
    , _candidateFor(road.cells().size())
{
}

void LTEIdleMode::start(std::size_t serving)
{
    _serving = serving;
    _report = {};
    std::ranges::fill(_candidateFor, std::chrono::milliseconds::zero());
    judgeServing();
    judgeOthers();
}

std::optional<LTEIdleMode::Reselection> LTEIdleMode::cycle()
{
    ++_turn;
    judgeServing();
    judgeOthers();
    if (_report.cyclesBelowZero >= CyclesUntilLost) {
        if (const auto cell = strongestSuitable())
            return Reselection {*cell, ReselectionRule::NotSuitable};
    }
    const auto best = bestOf(TReselection + Cycle); // seen at both ends of the time
    return best ? std::optional<Reselection>({*best, ruleFor(_road.cells()[*best])}) : std::nullopt;
}

ReselectionRule LTEIdleMode::ruleFor(const LTECell& cell) const
{
    const LTELayer& from = *servingCell().layer;
    if (cell.layer == &from)
        return ReselectionRule::EqualPriority;
    return cell.layer->priority > from.priority ? ReselectionRule::HigherPriority : ReselectionRule::LowerPriority;
}

void LTEIdleMode::judgeServing()
{
    using namespace LTEMeasurementRule;
    const LTECell& cell = servingCell();
    const LTELayer& layer = *cell.layer;
    const int level = cell.srxlev();
    std::uint8_t rules = 0;
    if (!layer.sIntraSearch || level <= *layer.sIntraSearch)
        rules |= SameCarrier;
    if (!layer.sNonIntraSearch || level <= *layer.sNonIntraSearch)
        rules |= LowerPriorities;
    if (std::ranges::any_of(LTERoad::layers(), [&](const LTELayer& other) { return other.priority > layer.priority; }))
        rules |= HigherPriorities;

    const LTEServingReport previous = _report;
    _report.channel = cell.downlinkChannel;
    _report.physicalCellId = cell.physicalCellId;
    _report.priority = layer.priority;
    _report.measured = cell.measured;
    _report.average = cell.average;
    _report.qRxLevMin = layer.qRxLevMin;
    _report.pMax = layer.pMax;
    _report.maxUETransmitPower = MaxUETransmitPower;
    _report.srxlev = level;
    _report.cyclesBelowZero = level < 0 ? std::min(previous.cyclesBelowZero + 1, MaxCycleCount) : 0;
    _report.sIntraSearch = layer.sIntraSearch;
    _report.sNonIntraSearch = layer.sNonIntraSearch;
    _report.areRulesUpdated = rules != previous.rules;
    _report.rules = rules;
}

void LTEIdleMode::judgeOthers()
{
    _candidates.clear();
    for (std::size_t index = 0; index < _road.cells().size(); ++index) {
        const LTECell& cell = _road.cells()[index];
        if (index == _serving || !isCandidate(cell)) {
            _candidateFor[index] = std::chrono::milliseconds::zero();
            continue;
        }
        _candidateFor[index] += Cycle;
        _candidates.push_back(
            {ReselectionTechnology::LTE, cell.layer->priority, cell.downlinkChannel, cell.physicalCellId, cell.band});
    }
    for (const OtherCell& cell : _road.otherCells()) {
        if (isCandidate(cell))
            _candidates.push_back(cell.candidate);
    }
}

bool LTEIdleMode::isCandidate(const LTECell& cell) const
{
    const LTELayer& from = *servingCell().layer;
    const LTELayer& to = *cell.layer;
    if (to.priority > from.priority)
        return cell.srxlev() > to.threshHigh;
    if (&to == &from)
        return cell.srxlev() > 0 && cell.average.rsrp > servingCell().average.rsrp + QHyst;
    return servingCell().srxlev() < from.threshServingLow && cell.srxlev() > to.threshLow;
}

bool LTEIdleMode::isCandidate(const OtherCell& cell) const
{
    constexpr int ThreshLow = 6; // dB
    return servingCell().srxlev() < servingCell().layer->threshServingLow && cell.srxlev() > ThreshLow;
}

std::optional<std::size_t> LTEIdleMode::bestOf(std::chrono::milliseconds minTime) const
{
    std::optional<std::size_t> best;
    const auto rank = [this](std::size_t index) {
        const LTECell& cell = _road.cells()[index];
        return std::pair(cell.layer->priority, cell.average.rsrp);
    };
    for (std::size_t index = 0; index < _candidateFor.size(); ++index) {
        if (_candidateFor[index] >= minTime && (!best || rank(index) > rank(*best)))
            best = index;
    }
    return best;
}

std::optional<std::size_t> LTEIdleMode::strongestSuitable() const
{
    std::optional<std::size_t> best;
    for (std::size_t index = 0; index < _road.cells().size(); ++index) {
        const LTECell& cell = _road.cells()[index];
        if (cell.srxlev() > 0 && (!best || cell.average.rsrp > _road.cells()[*best].average.rsrp))
            best = index;
    }
    return best;
}

std::vector<const LTELayer*> LTEIdleMode::carriersToMeasure() const
{
    using namespace LTEMeasurementRule;
    const LTELayer& own = *servingCell().layer;
    std::vector<const LTELayer*> carriers;
    for (const LTELayer& layer : LTERoad::layers()) {
        const std::uint8_t rule = &layer == &own ? SameCarrier
            : layer.priority > own.priority      ? HigherPriorities
                                                 : LowerPriorities;
        if (_report.rules & rule)
            carriers.push_back(&layer);
    }
    return carriers;
}

LTENeighbourReport LTEIdleMode::neighbours() const
{
    const auto carriers = carriersToMeasure();
    if (carriers.empty())
        return {};
    const LTELayer& carrier = *carriers[_turn % carriers.size()];
    LTENeighbourReport report {carrier.downlinkChannel, carrier.qRxLevMin, {}};
    for (const LTECell& cell : _road.cells()) {
        if (cell.layer == &carrier && &cell != &servingCell() && cell.average.rsrq > Audible)
            report.neighbours.push_back(neighbourReport(cell));
    }
    std::ranges::sort(report.neighbours, [](const auto& a, const auto& b) { return a.average.rsrp > b.average.rsrp; });
    report.neighbours.resize(std::min(report.neighbours.size(), MaxNeighbours));
    return report;
}

ReselectionReport LTEIdleMode::candidate() const
{
    ReselectionReport report {_report.channel, _report.physicalCellId, {}};
    if (!_candidates.empty())
        report.candidates.push_back(_candidates[_turn % _candidates.size()]);
    return report;
}

} // namespace spectrel
