#include "Telephony/Simulator/LTE/LTEWorld.h"

#include <algorithm>
#include <tuple>

namespace spectrel {

namespace {

constexpr double Offset = 3; // dB by which a cell must be stronger to be handed over to, event A3...
constexpr std::chrono::milliseconds TimeToTrigger {640}; // ... for this long (3GPP TS 36.331, TimeToTrigger)
constexpr double ConnectionLost = -127; // dBm of RSRP
constexpr double SignalLost = -138; // dBm of RSRP: the serving cell cannot even be detected
constexpr double Measurable = -19; // dB of RSRQ; of weaker cells the phone knows no more than that they are there
constexpr double Audible = -25; // dB of RSRQ
constexpr std::size_t MaxMeasured = 8;

CellName nameOf(const LTECell& cell)
{
    return {"lte", cell.downlinkChannel, cell.physicalCellId, cell.identity};
}

bool isStronger(const LTECell* a, const LTECell* b)
{
    return a->average.rsrp > b->average.rsrp;
}

} // namespace

LTEWorld::LTEWorld(Scene scene, std::uint32_t seed)
    : _dice(seed)
    , _journey(scene, LTERoad::Length, _dice)
    , _road(_dice)
    , _connection({12, 30}, {20, 50}, {6, 10}, _dice)
{
    if (scene == Scene::PingPong)
        _journey.stayAround(LTERoad::PacingPlace, LTERoad::PacingReach);
    _road.advance(std::chrono::milliseconds::zero(), _journey, _dice);
    _serving = strongest();
    _moves.first(nameOf(servingCell()));
    _idleMode.start(_serving);
}

void LTEWorld::advance(std::chrono::milliseconds step)
{
    _moves.begin();
    _elapsed += step;
    _journey.advance(step, _dice);
    _road.advance(step, _journey, _dice);
    const bool wasConnected = isConnected();
    _connection.advance(step, _dice);
    const bool isBack = _journey.scene() == Scene::Handover && servingCell().srxlev() > 0;
    if (!wantsConnection() || isBack)
        _hasLostConnection = false;
    if (_isInService && servingCell().average.rsrp < SignalLost)
        _isInService = false;
    if (!_isInService)
        return searchService();
    if (isConnected())
        advanceConnection(step);
    if (!isConnected())
        advanceIdle(wasConnected);
}

void LTEWorld::advanceIdle(bool hasJustBecomeIdle)
{
    if (hasJustBecomeIdle)
        _idleMode.start(_serving);
    if (_elapsed % LTEIdleMode::Cycle != std::chrono::milliseconds::zero())
        return;
    if (const auto chosen = _idleMode.cycle(); chosen && chosen->cell != _serving) {
        moveTo(chosen->cell, byReselection(chosen->rule));
        _idleMode.start(_serving);
    }
}

void LTEWorld::searchService()
{
    _hasLostConnection = wantsConnection();
    if (_elapsed % LTEIdleMode::Cycle != std::chrono::milliseconds::zero())
        return;
    const auto found = _idleMode.strongestSuitable();
    if (!found)
        return;
    _isInService = true;
    if (*found != _serving)
        moveTo(*found, AfterServiceLost);
    _idleMode.start(_serving);
}

void LTEWorld::moveTo(std::size_t cell, MoveCause cause)
{
    _moves.moved(nameOf(servingCell()), nameOf(_road.cells()[cell]), cause);
    _serving = cell;
}

void LTEWorld::advanceConnection(std::chrono::milliseconds step)
{
    handOver(step);
    _hasLostConnection = servingCell().average.rsrp < ConnectionLost;
    if (_hasLostConnection)
        return;
    _subframe = static_cast<std::uint8_t>(_dice.below(10));
    transfer(step);
}

void LTEWorld::handOver(std::chrono::milliseconds step)
{
    const std::size_t best = strongest();
    if (best == _serving || _road.cells()[best].average.rsrp < servingCell().average.rsrp + Offset) {
        _targetFor = {};
        return;
    }
    _targetFor = best == _target ? _targetFor + step : step;
    _target = best;
    if (_targetFor >= TimeToTrigger) {
        moveTo(best, ByHandover);
        _targetFor = {};
    }
}

void LTEWorld::transfer(std::chrono::milliseconds step)
{
    const double seconds = std::chrono::duration<double>(step).count();
    const double quality = std::clamp((servingCell().average.rsrp + 115) / 45, 0.02, 1.0);
    _received += 2.5e6 * quality * seconds * _dice.between(0.2, 1);
    _sent += 2.0e5 * quality * seconds * _dice.between(0.2, 1);
}

std::size_t LTEWorld::strongest() const
{
    const auto& cells = _road.cells();
    const auto best = std::ranges::max_element(
        cells, [](const LTECell& a, const LTECell& b) { return a.average.rsrp < b.average.rsrp; });
    return static_cast<std::size_t>(best - cells.begin());
}

LTEConnectedReport LTEWorld::connectedReport() const
{
    const LTECell& serving = servingCell();
    LTEConnectedReport report {serving.downlinkChannel, serving.physicalCellId, _subframe, serving.average, {}, {}};
    for (const LTECell* cell : neighbours(_road.cells().size())) {
        if (cell->layer != serving.layer || cell->average.rsrq < Audible)
            continue;
        if (cell->average.rsrq >= Measurable && report.measured.size() < MaxMeasured)
            report.measured.push_back({cell->physicalCellId, cell->average});
        else
            report.detected.push_back(cell->physicalCellId);
    }
    return report;
}

std::vector<const LTECell*> LTEWorld::neighbours(std::size_t maxCount) const
{
    std::vector<const LTECell*> others;
    for (const LTECell& cell : _road.cells()) {
        if (&cell != &servingCell())
            others.push_back(&cell);
    }
    std::ranges::sort(others, isStronger);
    others.resize(std::min(others.size(), maxCount));
    return others;
}

void LTEWorld::advanceAway(std::chrono::milliseconds step)
{
    _moves.begin();
    _elapsed += step;
    _journey.advance(step, _dice);
    _road.advance(step, _journey, _dice);
}

/// The cell that a phone from another technology would take.
std::size_t LTEWorld::bestFromOutside() const
{
    const auto rank = [](const LTECell& cell) {
        const bool isPreferable = cell.srxlev() > cell.layer->threshHigh;
        return std::tuple(isPreferable, isPreferable ? cell.layer->priority : 0, cell.average.rsrp);
    };
    const auto& cells = _road.cells();
    const auto best =
        std::ranges::max_element(cells, [&rank](const LTECell& a, const LTECell& b) { return rank(a) < rank(b); });
    return static_cast<std::size_t>(best - cells.begin());
}

Coverage LTEWorld::coverage() const
{
    const LTECell& cell = _road.cells()[bestFromOutside()];
    return {
        nameOf(cell), cell.average.rsrp, static_cast<double>(cell.srxlev()), cell.srxlev() > cell.layer->threshHigh};
}

double LTEWorld::servingMargin() const
{
    return servingCell().srxlev();
}

CellName LTEWorld::servingName() const
{
    return nameOf(servingCell());
}

bool LTEWorld::isOnOwnChannel() const
{
    return isConnected();
}

bool LTEWorld::isSettled() const
{
    return true;
}

void LTEWorld::arrive(Technology, MoveKind)
{
    _serving = bestFromOutside();
    _isInService = true;
    _hasLostConnection = false;
    _targetFor = {};
    _idleMode.start(_serving);
}

void LTEWorld::leave()
{
    _hasLostConnection = true;
}

void LTEWorld::setOthers(const Coverage& utran, const Coverage& gsm)
{
    _road.setOtherCells(utran, gsm);
}

} // namespace spectrel
