#include "Telephony/Simulator/GSMUMTS/GSMReceiver.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr double Audible = -108; // dBm
constexpr std::size_t MaxNeighbours = 6;
constexpr auto IdentifyingTime = 4s; // until a neighbour's BSIC has been read
constexpr auto SystemInformationTime = 1500ms;

constexpr std::uint8_t ReselectHysteresis = 6; // dB, with a data session
constexpr auto ReselectionTime = 5s;
constexpr double HandoverMargin = 4; // dB
constexpr auto HandoverTime = 1s;

constexpr auto ChangingTime = 1200ms;
constexpr auto ReselectingTime = 700ms;
constexpr auto SetupTime = 500ms;
constexpr auto ReleaseTime = 400ms;

std::int32_t whole(double value)
{
    return static_cast<std::int32_t>(std::lround(value));
}

} // namespace

GSMReceiver::GSMReceiver(const GSMUMTSRoad& road, MoveLog& moves)
    : _cells(road.gsm())
    , _moves(moves)
    , _heard(_cells.size())
{
}

void GSMReceiver::enter(RRState how)
{
    _isOn = true;
    serve(static_cast<std::size_t>(&strongestCell() - _cells.data()));
    become(how);
}

void GSMReceiver::depart(RRState how)
{
    become(how);
}

void GSMReceiver::leave()
{
    _isOn = false;
    _inCall = false;
    std::ranges::fill(_heard, 0ms);
    become(RRState::Inactive);
}

void GSMReceiver::advance(std::chrono::milliseconds step, const Demand& demand, Dice& dice)
{
    if (!_isOn)
        return;
    _inCall = demand.call;
    _inSession = demand.session;
    listen(step);
    if (!isChanging())
        reselect(step);
    advanceState(step, demand);
    if (isDedicated())
        judgeQuality(dice);
}

void GSMReceiver::listen(std::chrono::milliseconds step)
{
    _onCell += step;
    for (std::size_t cell = 0; cell < _cells.size(); ++cell)
        keepTime(_heard[cell], _cells[cell].rssi > Audible, step);
}

void GSMReceiver::advanceState(std::chrono::milliseconds step, const Demand& demand)
{
    _inState += step;
    if (const RRState next = nextState(demand); next != _rr.state)
        become(next);
    _rr.isData = isConnected() && !demand.call;
}

RRState GSMReceiver::nextState(const Demand& demand) const
{
    const auto after = [this](std::chrono::milliseconds time, RRState next) {
        return _inState >= time ? next : _rr.state;
    };
    switch (_rr.state) {
    case RRState::Inactive:
        return RRState::PLMNListConstruction;
    case RRState::PLMNListConstruction:
        return after(ChangingTime, RRState::CellSelection);
    case RRState::CellSelection:
        return after(ReselectingTime, RRState::Idle);
    case RRState::Idle:
        return demand.connection() ? RRState::ConnectionPending : RRState::Idle;
    case RRState::CellReselection:
        return after(ReselectingTime, RRState::Idle);
    case RRState::ConnectionPending:
        return after(SetupTime, demand.connection() ? RRState::DataTransfer : RRState::Idle);
    case RRState::DataTransfer:
        return demand.connection() ? RRState::DataTransfer : RRState::ConnectionRelease;
    case RRState::ConnectionRelease:
        return after(ReleaseTime, RRState::Idle);
    case RRState::FromUMTSByHandover:
        return after(ChangingTime, RRState::DataTransfer);
    case RRState::FromUMTSByReselection:
    case RRState::FromUMTSByOrder:
        return after(ChangingTime, RRState::Idle);
    case RRState::ToUMTSByReselection:
    case RRState::ToUMTSByHandover:
        return _rr.state; // until it has left
    }
    return _rr.state;
}

void GSMReceiver::become(RRState state)
{
    _rr.state = state;
    _rr.subState = state == RRState::CellReselection || isChanging() ? 1 : 0;
    _rr.status = _isOn ? 1 : 0;
    _rr.isData = false;
    _inState = 0ms;
}

bool GSMReceiver::isChanging() const
{
    switch (_rr.state) {
    case RRState::FromUMTSByHandover:
    case RRState::FromUMTSByReselection:
    case RRState::FromUMTSByOrder:
    case RRState::ToUMTSByReselection:
    case RRState::ToUMTSByHandover:
        return true;
    default:
        return false;
    }
}

void GSMReceiver::serve(std::size_t cell)
{
    _serving = cell;
    _onCell = 0ms;
    _candidateFor = 0ms;
}

void GSMReceiver::reselect(std::chrono::milliseconds step)
{
    const auto merit = [this](const GSMCell& cell) { return isDedicated() ? cell.rssi : cell.c2(); };
    const auto best = static_cast<std::size_t>(std::ranges::max_element(_cells, [&merit](const auto& a, const auto& b) {
        return merit(a) < merit(b);
    }) - _cells.begin());
    const double margin = isDedicated() ? HandoverMargin : _inSession ? ReselectHysteresis : 0;
    const bool isBetter = best != _serving && merit(_cells[best]) > merit(servingCell()) + margin;
    keepTime(_candidateFor, isBetter && best == _candidate, step);
    _candidate = best;
    if (_candidateFor < (isDedicated() ? std::chrono::milliseconds(HandoverTime) : ReselectionTime))
        return;
    if (isDedicated()) {
        _moves.moved(nameOf(servingCell()), nameOf(_cells[best]), ByHandover);
        serve(best);
    } else if (isConnected() || _rr.state == RRState::Idle) { // a packet transfer goes on on the new cell
        _moves.moved(nameOf(servingCell()), nameOf(_cells[best]), byReselection(ReselectionRule::EqualPriority));
        serve(best);
        become(RRState::CellReselection);
    }
}

/// From 7 (more than 12.8 % of the bits wrong) at the weakest to 0; the sub set is shorter and varies more.
void GSMReceiver::judgeQuality(Dice& dice)
{
    const double quality = (-74 - servingCell().rssi) / 5;
    const auto level = [quality](double variation) {
        return static_cast<std::uint8_t>(std::clamp(std::lround(quality + variation), 0L, 7L));
    };
    _fullQuality = level(dice.between(-0.6, 0.6));
    _subQuality = level(dice.between(-1.2, 1.2));
}

const GSMCell& GSMReceiver::strongestCell() const
{
    return *std::ranges::max_element(_cells, [](const GSMCell& a, const GSMCell& b) { return a.rssi < b.rssi; });
}

std::uint16_t GSMReceiver::dedicatedArfcn() const
{
    const GSMCell& cell = servingCell();
    return cell.hopping.arfcns.empty() ? cell.arfcn : cell.hopping.arfcns.front();
}

HoppingReport GSMReceiver::hopping() const
{
    return isDedicated() ? servingCell().hopping : HoppingReport();
}

GPRSParameters GSMReceiver::gprs() const
{
    return hasReadSystemInformation() ? servingCell().gprs : GPRSParameters();
}

bool GSMReceiver::hasReadSystemInformation() const
{
    return _onCell >= SystemInformationTime;
}

std::vector<const GSMCell*> GSMReceiver::neighbours() const
{
    std::vector<const GSMCell*> others;
    for (const GSMCell& cell : _cells) {
        if (cell.rssi > Audible && !(_isOn && &cell == &servingCell()))
            others.push_back(&cell);
    }
    std::ranges::sort(others, [](const GSMCell* a, const GSMCell* b) { return a->rssi > b->rssi; });
    others.resize(std::min(others.size(), MaxNeighbours));
    return others;
}

std::vector<IdentifiedGSMCell> GSMReceiver::identified() const
{
    std::vector<IdentifiedGSMCell> cells;
    for (const GSMCell* cell : neighbours()) {
        if (_heard[static_cast<std::size_t>(cell - _cells.data())] >= IdentifyingTime)
            cells.push_back({cell->arfcn, cell->bsic});
    }
    return cells;
}

GSMMeasurement GSMReceiver::measurement() const
{
    const GSMCell& cell = servingCell();
    GSMMeasurement measured;
    measured.arfcn = cell.arfcn;
    measured.rxLevel = rxLevel(cell.rssi);
    measured.isDedicated = isDedicated();
    measured.c1 = whole(cell.c1());
    measured.c2 = whole(cell.c2());
    measured.fullQuality = _fullQuality;
    measured.subQuality = _subQuality;
    measured.reselectHysteresis = _inSession ? ReselectHysteresis : 0;
    for (const GSMCell* neighbour : neighbours()) {
        measured.neighbours.push_back(
            {neighbour->arfcn, rxLevel(neighbour->rssi), whole(neighbour->c1()), whole(neighbour->c2())});
    }
    return measured;
}

} // namespace spectrel
