#include "Telephony/Simulator/GSMUMTS/UMTSReceiver.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr double Audible = -23; // dB of Ec/No
constexpr std::size_t MaxSetCells = 7;
constexpr std::size_t MaxRanked = 4;

constexpr std::size_t ActiveSetSize = 3;
constexpr double ReportingRange = 3; // dB below the strongest: event 1a
constexpr double DroppingRange = 6; // event 1b
constexpr double ReplacingMargin = 2; // dB over the weakest: event 1c
constexpr auto TimeToEnter = 300ms;
constexpr auto TimeToLeave = 600ms;

constexpr auto TReselection = 1s;
constexpr auto AveragingTime = 400ms; // of the level that cells are ranked by

constexpr auto ShortAverage = 200ms; // until a cell's energy has been averaged
constexpr auto LongAverage = 800ms;

constexpr auto SetupTime = 400ms;
constexpr auto SecurityTime = 500ms; // until the network has started ciphering
constexpr auto DedicatedPatience = 3s; // unused, until the network takes the channel away
constexpr auto SharedPatience = 5s;
constexpr auto PagingPatience = 20s;
constexpr auto ReleaseTime = 300ms;
constexpr double FastPhone = 14; // metres a second: so fast a phone reports only its registration area

} // namespace

UMTSReceiver::UMTSReceiver(const GSMUMTSRoad& road, MoveLog& moves)
    : _road(road)
    , _cells(road.umts())
    , _moves(moves)
    , _timers(_cells.size())
{
}

void UMTSReceiver::enter(RRCState state)
{
    serveOnly(static_cast<std::size_t>(&strongestCell() - _cells.data()));
    become(state);
}

void UMTSReceiver::leave()
{
    _active.clear();
    become(RRCState::Disconnected);
}

void UMTSReceiver::advance(std::chrono::milliseconds step, const Demand& demand)
{
    listen(step);
    if (!isOn())
        return;
    advanceConnection(step, demand);
    if (_state == RRCState::CellDCH)
        updateActiveSet(step);
    else
        reselect(step);
}

void UMTSReceiver::listen(std::chrono::milliseconds step)
{
    const double share = std::chrono::duration<double>(step) / AveragingTime;
    for (std::size_t cell = 0; cell < _cells.size(); ++cell) {
        Timers& timers = _timers[cell];
        keepTime(timers.heard, _cells[cell].ecno > Audible, step);
        timers.averageRscp += (_cells[cell].rscp - timers.averageRscp) * std::min(share, 1.0);
    }
}

void UMTSReceiver::serveOnly(std::size_t cell)
{
    _serving = cell;
    _active = {cell};
    _candidateFor = 0ms;
    for (Timers& timers : _timers)
        timers.enters = timers.leaves = 0ms;
}

void UMTSReceiver::reselect(std::chrono::milliseconds step)
{
    const auto better = [this](const UMTSCell& a, const UMTSCell& b) {
        return _timers[static_cast<std::size_t>(&a - _cells.data())].averageRscp
            < _timers[static_cast<std::size_t>(&b - _cells.data())].averageRscp;
    };
    const auto best = static_cast<std::size_t>(std::ranges::max_element(_cells, better) - _cells.begin());
    const bool isBetter = best != _serving && _timers[best].averageRscp > servingRank();
    keepTime(_candidateFor, isBetter && best == _candidate, step);
    _candidate = best;
    if (_candidateFor < TReselection)
        return;
    _moves.moved(nameOf(servingCell()), nameOf(_cells[best]), byReselection(ReselectionRule::EqualPriority));
    serveOnly(best);
}

void UMTSReceiver::updateActiveSet(std::chrono::milliseconds step)
{
    dismiss(step);
    admit(step);
    const std::size_t strongest = strongestActive();
    if (strongest != _serving)
        _moves.moved(nameOf(servingCell()), nameOf(_cells[strongest]), ByHandover);
    _serving = strongest;
}

void UMTSReceiver::admit(std::chrono::milliseconds step)
{
    for (std::size_t cell = 0; cell < _cells.size(); ++cell) {
        const bool isFull = _active.size() == ActiveSetSize;
        const double threshold =
            isFull ? _cells[weakestActive()].ecno + ReplacingMargin : _cells[strongestActive()].ecno - ReportingRange;
        keepTime(_timers[cell].enters, !isActive(cell) && _cells[cell].ecno > threshold, step);
        if (_timers[cell].enters < TimeToEnter)
            continue;
        if (isFull)
            std::erase(_active, weakestActive());
        _active.push_back(cell);
        _timers[cell].enters = _timers[cell].leaves = 0ms;
    }
}

void UMTSReceiver::dismiss(std::chrono::milliseconds step)
{
    const double threshold = _cells[strongestActive()].ecno - DroppingRange;
    std::erase_if(_active, [&](std::size_t cell) {
        keepTime(_timers[cell].leaves, _cells[cell].ecno < threshold, step);
        return _timers[cell].leaves >= TimeToLeave;
    });
}

void UMTSReceiver::advanceConnection(std::chrono::milliseconds step, const Demand& demand)
{
    _inState += step;
    keepTime(_connectedFor, isConnected(), step);
    keepTime(_unused, !(_state == RRCState::CellDCH ? demand.dedicated() : demand.connection()), step);
    if (const RRCState next = nextState(demand); next != _state)
        become(next);
}

void UMTSReceiver::become(RRCState state)
{
    if (_state == RRCState::CellDCH && isOn())
        serveOnly(_serving);
    _state = state;
    _inState = _unused = 0ms;
    if (!isConnected())
        _connectedFor = 0ms;
}

RRCState UMTSReceiver::nextState(const Demand& demand) const
{
    switch (_state) {
    case RRCState::Disconnected:
        return demand.connection() && _inState >= ReleaseTime ? RRCState::Connecting : _state;
    case RRCState::Connecting:
        if (_inState < SetupTime)
            return _state;
        return demand.dedicated() ? RRCState::CellDCH : RRCState::CellFACH;
    case RRCState::CellDCH:
        return afterDedicated(demand);
    case RRCState::CellFACH:
        return afterShared(demand);
    case RRCState::CellPCH:
    case RRCState::URAPCH:
        return afterPaging(demand);
    }
    return _state;
}

RRCState UMTSReceiver::afterDedicated(const Demand& demand) const
{
    if (demand.session || demand.signalling)
        return _unused >= DedicatedPatience ? RRCState::CellFACH : _state;
    return _unused >= ReleaseTime ? RRCState::Disconnected : _state;
}

RRCState UMTSReceiver::afterShared(const Demand& demand) const
{
    if (demand.dedicated())
        return RRCState::CellDCH;
    if (_unused < (demand.session ? std::chrono::milliseconds(SharedPatience) : ReleaseTime))
        return _state;
    if (!demand.session)
        return RRCState::Disconnected;
    return _road.speed() > FastPhone ? RRCState::URAPCH : RRCState::CellPCH;
}

RRCState UMTSReceiver::afterPaging(const Demand& demand) const
{
    if (demand.connection())
        return RRCState::CellFACH;
    return !demand.session || _inState >= PagingPatience ? RRCState::Disconnected : _state;
}

bool UMTSReceiver::isCiphering() const
{
    return _connectedFor >= SecurityTime;
}

bool UMTSReceiver::isActive(std::size_t cell) const
{
    return std::ranges::find(_active, cell) != _active.end();
}

/// Whether the network asks the phone to look for it: it stands on the serving site or on the next one either way.
bool UMTSReceiver::isNeighbour(const UMTSCell& cell) const
{
    const std::size_t sites = _cells.back().site + 1;
    const std::size_t apart = (cell.site + sites - servingCell().site) % sites;
    return apart <= 1 || apart == sites - 1;
}

std::size_t UMTSReceiver::strongestActive() const
{
    return *std::ranges::max_element(
        _active, [this](std::size_t a, std::size_t b) { return _cells[a].ecno < _cells[b].ecno; });
}

std::size_t UMTSReceiver::weakestActive() const
{
    return *std::ranges::min_element(
        _active, [this](std::size_t a, std::size_t b) { return _cells[a].ecno < _cells[b].ecno; });
}

std::vector<const UMTSCell*> UMTSReceiver::activeSet() const
{
    std::vector<const UMTSCell*> set;
    for (const std::size_t cell : _active)
        set.push_back(&_cells[cell]);
    std::ranges::sort(set, [](const UMTSCell* a, const UMTSCell* b) { return a->ecno > b->ecno; });
    return set;
}

const UMTSCell& UMTSReceiver::strongestCell() const
{
    return *std::ranges::max_element(_cells, [](const UMTSCell& a, const UMTSCell& b) { return a.rscp < b.rscp; });
}

UMTSSetCell UMTSReceiver::setCell(std::size_t cell, CellSet set) const
{
    const auto heard = _timers[cell].heard;
    const EnergyAverages averages = heard >= LongAverage ? EnergyAverages::Long
        : heard >= ShortAverage                          ? EnergyAverages::Short
                                                         : EnergyAverages::None;
    return {_cells[cell].scramblingCode, set, _cells[cell].ecno, averages};
}

CellSetsReport UMTSReceiver::cellSets() const
{
    CellSetsReport report {_road.carrierRssi(), {}};
    std::vector<UMTSSetCell> others;
    for (std::size_t cell = 0; cell < _cells.size() && isOn(); ++cell) {
        if (isActive(cell))
            report.cells.push_back(setCell(cell, CellSet::Active));
        else if (_cells[cell].ecno > Audible)
            others.push_back(setCell(cell, isNeighbour(_cells[cell]) ? CellSet::Monitored : CellSet::Detected));
    }
    const auto stronger = [](const UMTSSetCell& a, const UMTSSetCell& b) { return a.ecno > b.ecno; };
    std::ranges::sort(report.cells, stronger);
    std::ranges::sort(others, stronger);
    others.resize(std::min(others.size(), MaxSetCells - report.cells.size()));
    report.cells.insert(report.cells.end(), others.begin(), others.end());
    return report;
}

double UMTSReceiver::servingRank() const
{
    return _timers[_serving].averageRscp + UMTSThresholds::QHyst1s;
}

std::vector<RankedUMTSCell> UMTSReceiver::ranking() const
{
    std::vector<RankedUMTSCell> ranked;
    for (std::size_t index = 0; index < _cells.size(); ++index) {
        const UMTSCell& cell = _cells[index];
        if (isActive(index) || cell.ecno <= Audible)
            continue;
        const double average = _timers[index].averageRscp;
        const bool isMeasured = _timers[index].heard >= LongAverage;
        ranked.push_back(
            {cell.downlinkChannel, cell.scramblingCode, cell.rscp, average, cell.ecno, average, isMeasured});
    }
    std::ranges::sort(ranked, [](const RankedUMTSCell& a, const RankedUMTSCell& b) { return a.rank > b.rank; });
    ranked.resize(std::min(ranked.size(), MaxRanked));
    return ranked;
}

} // namespace spectrel
