#include "Telephony/Simulator/GSMUMTS/GSMUMTSWorld.h"

#include <algorithm>
#include <array>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr auto SearchTime = 2500ms; // from power-on until a cell is found
constexpr double SelectableEcno = -14; // dB

constexpr auto TReselection = 2s; // to GSM
constexpr auto RankedTogether = 600ms; // until the report shows both systems
constexpr double WeakEcno = -14; // dB, event 2d in a connection
constexpr auto WeakTime = 600ms;
constexpr auto LossTime = 2s; // without any suitable cell
constexpr double LostEcno = -22; // dB: nothing gets through

constexpr double FDDQMin = -10; // dB (3GPP TS 45.008, 6.6.5)
constexpr double ReturnRscp = -103; // dBm
constexpr auto ReturnTime = 5s;
constexpr auto ReturnTimeInCall = 2s;
constexpr auto DepartureTime = 800ms;

constexpr double BitsInByte = 8;
constexpr double GPRSRate = 12000; // bytes a second, at best

/// Two networks of the test country. Their entries overlap in the record, and these agree where they do.
constexpr std::array<PLMN, 2> EquivalentNetworks {{{{0, 0, 1}, {2, 0, 0}}, {{0, 0, 1}, {1, 0, 4}}}};

} // namespace

GSMUMTSWorld::GSMUMTSWorld(Scene scene, std::uint32_t seed)
    : _dice(seed)
    , _road(scene, _dice)
    , _usage(scene, _dice)
    , _umts(_road, _moves)
    , _gsm(_road, _moves)
{
    _now = _before = situation();
}

void GSMUMTSWorld::advance(std::chrono::milliseconds step)
{
    _moves.begin();
    _elapsed += step;
    _road.advance(step, _dice);
    _usage.advance(step, _mobility.isAttached(), _dice);
    chooseSystem(step);
    const Demand wanted = demand();
    _umts.advance(step, wanted);
    _gsm.advance(step, wanted, _dice);
    _mobility.advance(step, {place(), isConnected(), isRejecting(), _usage.wantsCall(), _usage.wantsTransfer()});
    _traffic.advance(step, _umts, wanted, _dice);
    transfer(step);
    _before = _now;
    _now = situation();
}

RadioSystem GSMUMTSWorld::system() const
{
    if (_umts.isOn())
        return RadioSystem::UMTS;
    return _gsm.isOn() ? RadioSystem::GSM : RadioSystem::None;
}

Demand GSMUMTSWorld::demand() const
{
    return {_mobility.isSignalling(), _mobility.isCalling(), _usage.hasSession(),
        _usage.wantsTransfer() && _mobility.mayTransfer()};
}

Place GSMUMTSWorld::place() const
{
    if (_umts.isOn())
        return {RadioSystem::UMTS, _umts.servingCell().locationArea, _umts.servingCell().routingArea};
    if (_gsm.isOn())
        return {RadioSystem::GSM, _gsm.servingCell().locationArea, _gsm.servingCell().routingArea};
    return {};
}

void GSMUMTSWorld::chooseSystem(std::chrono::milliseconds step)
{
    switch (system()) {
    case RadioSystem::None:
        return searchSystem();
    case RadioSystem::UMTS:
        return considerGSM(step);
    case RadioSystem::GSM:
        return considerUMTS(step);
    }
}

void GSMUMTSWorld::searchSystem()
{
    if (_elapsed < SearchTime)
        return;
    if (_umts.strongestCell().ecno > SelectableEcno) {
        _umts.enter(RRCState::Disconnected);
        noteFound(nameOf(_umts.servingCell()));
    } else if (_gsm.strongestCell().c1() > 0) {
        _gsm.enter(RRState::PLMNListConstruction);
        noteFound(nameOf(_gsm.servingCell()));
    }
}

void GSMUMTSWorld::noteFound(const CellName& cell)
{
    if (!_lostCell)
        _moves.first(cell);
    else if (*_lostCell != cell)
        _moves.moved(*_lostCell, cell, AfterServiceLost);
}

void GSMUMTSWorld::loseService(const CellName& last)
{
    _lostCell = last;
    _umts.leave();
    _gsm.leave();
    _leaving = _departing = 0ms;
}

bool GSMUMTSWorld::measuresGSM() const
{
    return _gsm.isOn() || (_umts.isOn() && _umts.servingCell().ecno < UMTSThresholds::SearchGSMBelow);
}

bool GSMUMTSWorld::isUMTSSuitable() const
{
    const UMTSCell& cell = _umts.servingCell();
    return cell.ecno >= UMTSThresholds::QQualMin && cell.rscp >= UMTSThresholds::QRxLevMin;
}

bool GSMUMTSWorld::isUMTSTooWeak() const
{
    const UMTSCell& cell = _umts.servingCell();
    if (_umts.state() == RRCState::CellDCH)
        return cell.ecno < WeakEcno;
    if (!isUMTSSuitable())
        return true;
    return measuresGSM() && _gsm.strongestCell().rssi - UMTSThresholds::QOffset1 > _umts.servingRank();
}

void GSMUMTSWorld::considerGSM(std::chrono::milliseconds step)
{
    keepTime(_leaving, isUMTSTooWeak(), step);
    const bool hasOwnChannel = _umts.state() == RRCState::CellDCH;
    if (_leaving < (hasOwnChannel ? WeakTime : std::chrono::milliseconds(TReselection)))
        return;
    if (_mobility.isSignalling() && _umts.servingCell().ecno > LostEcno)
        return; // the procedure is let finish
    const CellName from = nameOf(_umts.servingCell());
    if (_gsm.strongestCell().c1() < 0)
        return loseService(from);
    const MoveCause cause = causeOfMoveToGSM();
    const RRState onAChannel = _mobility.isCalling() ? RRState::FromUMTSByHandover : RRState::FromUMTSByOrder;
    _umts.leave();
    _gsm.enter(hasOwnChannel ? onAChannel : RRState::FromUMTSByReselection);
    _moves.moved(from, nameOf(_gsm.servingCell()), cause);
    _leaving = 0ms;
}

MoveCause GSMUMTSWorld::causeOfMoveToGSM() const
{
    if (_umts.state() == RRCState::CellDCH)
        return _mobility.isCalling() ? ByHandover : ByRedirection;
    return byReselection(isUMTSSuitable() ? ReselectionRule::EqualPriority : ReselectionRule::NotSuitable);
}

void GSMUMTSWorld::considerUMTS(std::chrono::milliseconds step)
{
    keepTime(_fading, _gsm.strongestCell().c1() < 0, step);
    if (_fading >= LossTime)
        return loseService(nameOf(_gsm.servingCell()));
    if (_departing > 0ms)
        return moveToUMTS(step);
    const UMTSCell& cell = _umts.strongestCell();
    const bool isGood = cell.ecno > FDDQMin && cell.rscp > ReturnRscp;
    keepTime(_leaving, isGood && !_gsm.isChanging(), step);
    const bool inCall = _gsm.isDedicated();
    const bool isBusy = _mobility.isSignalling() || (_mobility.isCalling() && !inCall);
    if (isBusy || !_gsm.isSettled() || _leaving < (inCall ? ReturnTimeInCall : ReturnTime))
        return;
    _gsm.depart(inCall ? RRState::ToUMTSByHandover : RRState::ToUMTSByReselection);
    _departing = step;
    _leaving = 0ms;
}

void GSMUMTSWorld::moveToUMTS(std::chrono::milliseconds step)
{
    _departing += step;
    if (_departing < DepartureTime)
        return;
    const bool byHandover = _gsm.rr().state == RRState::ToUMTSByHandover;
    const CellName from = nameOf(_gsm.servingCell());
    _gsm.leave();
    _umts.enter(byHandover ? RRCState::CellDCH : RRCState::Disconnected);
    _moves.moved(
        from, nameOf(_umts.servingCell()), byHandover ? ByHandover : byReselection(ReselectionRule::EqualPriority));
    _departing = 0ms;
}

std::vector<RankedGSMCell> GSMUMTSWorld::gsmRanking() const
{
    std::vector<RankedGSMCell> ranked;
    for (const GSMCell* cell : _gsm.neighbours()) {
        const double rank = cell->rssi - UMTSThresholds::QOffset1;
        ranked.push_back({cell->arfcn, cell->bsic, cell->rssi, rank});
    }
    return ranked;
}

RankingReport GSMUMTSWorld::ranking() const
{
    if (_gsm.isOn() || !measuresGSM())
        return {_umts.ranking(), {}};
    return {_leaving >= RankedTogether ? _umts.ranking() : std::vector<RankedUMTSCell>(), gsmRanking()};
}

bool GSMUMTSWorld::isRejecting() const
{
    constexpr std::uint16_t RejectingArea = 1202;
    return _road.scene() == Scene::Rejected && place().locationArea == RejectingArea;
}

std::span<const PLMN> GSMUMTSWorld::equivalentNetworks() const
{
    const std::span all(EquivalentNetworks);
    if (_mobility.knownLocation().system == RadioSystem::None)
        return all.first(0);
    return _mobility.knownLocation().system == RadioSystem::GSM ? all.first(1) : all;
}

void GSMUMTSWorld::transfer(std::chrono::milliseconds step)
{
    const double seconds = std::chrono::duration<double>(step).count();
    double received = _traffic.received() / BitsInByte;
    if (_gsm.isConnected() && !_gsm.isDedicated() && _usage.wantsTransfer())
        received = GPRSRate * seconds * std::clamp((_gsm.servingCell().rssi + 105) / 40, 0.1, 1.0);
    _received += received;
    _sent += received * 0.08;
}

GSMUMTSCellInformation GSMUMTSWorld::cellInformation() const
{
    GSMUMTSCellInformation information {_now.umtsCell, _now.gsmCell, {}, {}, measuresGSM()};
    if (system() != RadioSystem::None) {
        information.umtsNeighbours = _umts.ranking();
        information.gsmNeighbours = _gsm.neighbours();
    }
    return information;
}

std::optional<PacketTransfer> GSMUMTSWorld::session() const
{
    if (!_now.hasSession)
        return std::nullopt;
    return PacketTransfer {bytesReceived(), static_cast<std::uint64_t>(_sent)};
}

NetworkReport GSMUMTSWorld::network() const
{
    NetworkReport report;
    report.service = _mobility.service();
    if (system() == RadioSystem::None)
        return report;
    report.network = TestNetwork;
    report.locationArea = place().locationArea;
    report.routingArea = place().routingArea;
    return report;
}

Situation GSMUMTSWorld::situation() const
{
    Situation situation;
    situation.system = system();
    situation.mm = _mobility.mm();
    situation.gmm = _mobility.gmm();
    situation.registration = _mobility.registration();
    situation.network = network();
    situation.knownLocation = _mobility.knownLocation();
    situation.knownRouting = _mobility.knownRouting();
    situation.rrc = _umts.state();
    situation.isCiphering = _umts.isCiphering();
    situation.rr = _gsm.rr();
    situation.umtsCell = _umts.isOn() ? &_umts.servingCell() : nullptr;
    situation.gsmCell = _gsm.isOn() ? &_gsm.servingCell() : nullptr;
    situation.isOnDCH = _umts.state() == RRCState::CellDCH;
    situation.isSending = situation.isOnDCH || _umts.state() == RRCState::CellFACH;
    situation.isDedicated = _gsm.isDedicated();
    situation.usesDTX = _gsm.usesDTX();
    situation.hopping = _gsm.hopping();
    if (_gsm.isOn())
        situation.gprs = _gsm.gprs();
    situation.measuresGSM = measuresGSM();
    situation.hasSession = _usage.hasSession();
    return situation;
}

void GSMUMTSWorld::advanceAway(std::chrono::milliseconds step)
{
    _moves.begin();
    _elapsed += step;
    _road.advance(step, _dice);
}

Coverage GSMUMTSWorld::coverage() const
{
    const GSMCell& cell = _gsm.strongestCell();
    return {nameOf(cell), cell.rssi, cell.c1(), false};
}

double GSMUMTSWorld::servingMargin() const
{
    return _gsm.isOn() ? _gsm.servingCell().c1() : 0;
}

CellName GSMUMTSWorld::servingName() const
{
    return nameOf(_gsm.servingCell());
}

bool GSMUMTSWorld::isOnOwnChannel() const
{
    return _gsm.isConnected();
}

bool GSMUMTSWorld::isSettled() const
{
    return _gsm.isSettled() && !_mobility.isSignalling() && !_mobility.isCalling();
}

void GSMUMTSWorld::arrive(Technology from, MoveKind how)
{
    const RRState fromUMTS = how == MoveKind::Redirection ? RRState::FromUMTSByOrder : RRState::FromUMTSByReselection;
    _gsm.enter(from == Technology::UTRAN ? fromUMTS : RRState::CellSelection);
    _now = _before = situation();
}

void GSMUMTSWorld::leave()
{
    _umts.leave();
    _gsm.leave();
    _leaving = _departing = _fading = 0ms;
}

void GSMUMTSWorld::setOthers(const Coverage&, const Coverage&) { }

} // namespace spectrel
