#include "Telephony/Simulator/UTRAN/UTRANWorld.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr double OwnLength = 5000; // metres, a ring
constexpr double SiteDistance = 400;
constexpr double GSMSiteDistance = 700;
constexpr Valley OwnSiteLess {2000, 3200, 22};
constexpr Valley SiteLessOnJourney {3300, 4700, 22};

constexpr OpenWater Water {1500, 1950}; // in front of the first site
constexpr double PacingPlace = 1000; // between two sites
constexpr double PacingReach = 75;

constexpr double Power = 33; // dBm, common control channel
constexpr double GSMPower = 43;
constexpr double Noise = -106; // dBm in 1.28 MHz, noise figure 7 dB
constexpr double TargetSignal = 5; // dB, of the power control
constexpr auto TReselection = 1s;

constexpr std::array<std::uint16_t, 3> Channels {10054, 10062, 10071};

constexpr double NamedDistance = 1000; // metres between a cell and the neighbours that it names
constexpr double Audible = -112; // dBm
constexpr double Detectable = -100; // dBm, of a cell that is not named
constexpr double JointDetectionRange = 15; // dB below the serving cell
constexpr std::size_t MaxNeighbours = 10;
constexpr std::size_t MaxGSMNeighbours = 6;
constexpr double GSMAudible = -108; // dBm

double milliwatts(double dBm)
{
    return std::pow(10, dBm / 10);
}

/// Percent: one at the target, ten times as many with each 4 dB less.
std::uint8_t blockErrors(double signalToInterference)
{
    const double errors = std::pow(10, (TargetSignal - signalToInterference) / 4);
    return static_cast<std::uint8_t>(std::min(std::round(errors), 100.0));
}

CellName nameOf(const UTRANCell& cell)
{
    return {"umts", cell.channel, cell.cellParameterId, cell.identity};
}

std::uint8_t signalSteps(double decibels)
{
    return static_cast<std::uint8_t>(std::clamp(std::round((decibels + 11) * 2), 0.0, 63.0));
}

} // namespace

UTRANWorld::UTRANWorld(Scene scene, std::uint32_t seed)
    : _dice(seed)
    , _roadLength(scene == Scene::Journey ? Journey::SharedLength : OwnLength)
    , _siteLess(scene == Scene::Journey ? SiteLessOnJourney : OwnSiteLess)
    , _journey(scene, _roadLength, _dice)
    , _calls({40, 80}, {15, 30}, {25, 40}, _dice)
    , _transfers({15, 45}, {8, 20}, {4, 8}, _dice)
{
    buildRoad();
    if (scene == Scene::PingPong)
        _journey.stayAround(PacingPlace, PacingReach);
    measure();
    _serving = strongest();
    _moves.first(nameOf(servingCell()));
}

void UTRANWorld::buildRoad()
{
    std::uint32_t number = 301;
    for (double position = 0; position < _roadLength; position += SiteDistance, ++number) {
        if (position > _siteLess.from && position < _siteLess.to)
            continue;
        UTRANCell cell;
        cell.identity = 12u << 16 | number;
        cell.locationArea = static_cast<std::uint16_t>(position < _roadLength / 2 ? 4101 : 4102);
        cell.registrationArea = static_cast<std::uint8_t>(position < _roadLength / 2 ? 17 : 18);
        cell.channel = Channels[_dice.below(Channels.size())];
        cell.cellParameterId = static_cast<std::uint8_t>(_dice.below(128));
        cell.position = position + _dice.between(-40, 40);
        cell.offset = _dice.between(30, 100);
        _cells.push_back(cell);
        _shadowing.emplace_back(_dice);
    }
    for (double position = 0; position < _roadLength; position += GSMSiteDistance) {
        GSMNeighbour cell;
        cell.identity = static_cast<std::uint16_t>(_dice.below(0x4000));
        cell.networkColour = static_cast<std::uint8_t>(_dice.below(8));
        cell.stationColour = static_cast<std::uint8_t>(_dice.below(8));
        cell.channel = static_cast<std::uint16_t>(512 + _dice.below(374)); // 1800 MHz
        cell.position = position + _dice.between(-80, 80);
        _gsmCells.push_back(cell);
        _gsmShadowing.emplace_back(_dice);
    }
}

void UTRANWorld::advance(std::chrono::milliseconds step)
{
    _moves.begin();
    advanceRoad(step);
    reselect(step);
    controlPower();
    _calls.advance(step, _dice);
    _transfers.advance(step, _dice);
    if (isInService())
        _connection.advance(step, isCalling() || _transfers.isOn());
    else
        _connection.lose();
    if (_connection.isOnDedicatedChannel() && _transfers.isOn()) {
        const double seconds = std::chrono::duration<double>(step).count();
        _received += 180e3 * seconds * _dice.between(0.3, 1);
        _sent += 20e3 * seconds * _dice.between(0.3, 1);
    }
}

void UTRANWorld::advanceRoad(std::chrono::milliseconds step)
{
    _journey.advance(step, _dice);
    for (auto* shadowings : {&_shadowing, &_gsmShadowing}) {
        for (Shadowing& shadowing : *shadowings)
            shadowing.advance(step, _dice);
    }
    measure();
}

void UTRANWorld::measure()
{
    const double hills = _siteLess.lossAt(_journey) + _journey.tunnelLoss();
    for (std::size_t index = 0; index < _cells.size(); ++index) {
        UTRANCell& cell = _cells[index];
        const double loss = pathLoss(_journey.distanceTo(cell.position, cell.offset)) + hills;
        const double water = index == 0 ? Water.gainAt(_journey) : 0;
        cell.rscp = std::clamp(Power - loss + _shadowing[index].decibels() + water, -130.0, -25.0);
    }
    for (std::size_t index = 0; index < _gsmCells.size(); ++index) {
        GSMNeighbour& cell = _gsmCells[index];
        const double loss = pathLoss(_journey.distanceTo(cell.position, 150)) + _journey.tunnelLoss();
        cell.rssi = std::clamp(GSMPower - loss + _gsmShadowing[index].decibels(), -115.0, -40.0);
    }
}

/// The cell-ranking criterion; on a dedicated channel the network hands over by the same measure.
void UTRANWorld::reselect(std::chrono::milliseconds step)
{
    const auto others = otherCells();
    const auto best = std::ranges::find_if(others, [this](const UTRANCell* cell) { return isMeasured(*cell); });
    const bool isRankedAbove = best != others.end() && (*best)->rscp > UTRANThresholds::QRxLevMin
        && (*best)->rscp > servingCell().rscp + UTRANThresholds::QHyst1s;
    if (!isRankedAbove) {
        _candidateFor = 0ms;
        return;
    }
    const auto index = static_cast<std::size_t>(*best - _cells.data());
    _candidateFor = index == _candidate ? _candidateFor + step : step;
    _candidate = index;
    if (_candidateFor >= TReselection) {
        _moves.moved(nameOf(servingCell()), nameOf(_cells[index]), causeOfMove());
        _serving = index;
        _candidateFor = 0ms;
    }
}

/// Of a move from the serving cell, now.
MoveCause UTRANWorld::causeOfMove() const
{
    if (!isInService())
        return AfterServiceLost;
    return _connection.isOnDedicatedChannel() ? ByHandover : byReselection(ReselectionRule::EqualPriority);
}

std::vector<const UTRANCell*> UTRANWorld::otherCells() const
{
    std::vector<const UTRANCell*> others;
    for (const UTRANCell& cell : _cells) {
        if (&cell != &servingCell())
            others.push_back(&cell);
    }
    std::ranges::sort(others, [](const UTRANCell* a, const UTRANCell* b) { return a->rscp > b->rscp; });
    return others;
}

bool UTRANWorld::isNamed(const UTRANCell& cell) const
{
    return std::fabs(std::remainder(cell.position - servingCell().position, _roadLength)) <= NamedDistance;
}

bool UTRANWorld::isMeasured(const UTRANCell& cell) const
{
    return cell.channel == servingCell().channel || _connection.isOnDedicatedChannel()
        || srxlev() <= UTRANThresholds::SInterSearch;
}

bool UTRANWorld::isDetected(const UTRANCell& cell) const
{
    return _connection.isOnDedicatedChannel() && cell.channel == servingCell().channel && cell.rscp > Detectable;
}

std::vector<UTRANNeighbour> UTRANWorld::neighbours() const
{
    std::vector<UTRANNeighbour> reported;
    const auto report = [&](const UTRANCell& cell, UTRANCellSet set) {
        const bool isNear =
            cell.channel == servingCell().channel && cell.rscp > servingCell().rscp - JointDetectionRange;
        reported.push_back({cell.channel, cell.cellParameterId, cell.rscp, set, isNear});
    };
    if (_connection.isOnDedicatedChannel())
        report(servingCell(), UTRANCellSet::Active);
    for (const UTRANCell* cell : otherCells()) {
        if (reported.size() == MaxNeighbours)
            break;
        if (!isNamed(*cell) && isDetected(*cell))
            report(*cell, UTRANCellSet::Detected);
        else if (isNamed(*cell) && isMeasured(*cell) && cell->rscp > Audible)
            report(*cell, UTRANCellSet::Monitored);
    }
    return reported;
}

std::vector<GSMNeighbour> UTRANWorld::gsmNeighbours() const
{
    std::vector<GSMNeighbour> reported = _gsmCells;
    std::erase_if(reported, [](const GSMNeighbour& cell) { return cell.rssi < GSMAudible; });
    std::ranges::sort(reported, [](const GSMNeighbour& a, const GSMNeighbour& b) { return a.rssi > b.rssi; });
    reported.resize(std::min(reported.size(), MaxGSMNeighbours));
    return reported;
}

/// Power control holds the target, as long as the serving cell is strong enough against the others on its channel and
/// the noise.
void UTRANWorld::controlPower()
{
    double interference = milliwatts(Noise);
    for (const UTRANCell* cell : otherCells()) {
        if (cell->channel == servingCell().channel)
            interference += milliwatts(cell->rscp);
    }
    const double maxSignal = servingCell().rscp - 10 * std::log10(interference);
    _signalToInterference = std::min(TargetSignal, maxSignal) + _dice.between(-1.5, 1.5);
}

TransportReport UTRANWorld::transportChannels() const
{
    TransportReport report;
    if (!_connection.isOnDedicatedChannel())
        return report;
    const double signal = _signalToInterference;
    const auto addComposite = [&](std::uint8_t slots, std::initializer_list<std::uint8_t> channels) {
        CodedCompositeChannel composite;
        composite.number = static_cast<std::uint8_t>(report.composites.size() + 1);
        composite.slots = slots;
        for (std::uint8_t slot = 0; slot < slots; ++slot) // later slots are a little more crowded
            composite.signalToInterference[slot] = signalSteps(signal - slot);
        report.composites.push_back(composite);
        for (const std::uint8_t channel : channels)
            report.channels.push_back({channel, blockErrors(signal - slots + 1)});
    };
    if (isCalling())
        addComposite(1, {1, 2, 3}); // the three classes of speech bits
    if (_transfers.isOn())
        addComposite(3, {6});
    if (report.composites.empty())
        addComposite(1, {}); // until the network's timer runs out only signalling is left
    report.channels.push_back({24, blockErrors(signal)}); // signalling
    return report;
}

void UTRANWorld::advanceAway(std::chrono::milliseconds step)
{
    _moves.begin();
    advanceRoad(step);
}

std::size_t UTRANWorld::strongest() const
{
    return static_cast<std::size_t>(std::ranges::max_element(_cells, {}, &UTRANCell::rscp) - _cells.begin());
}

Coverage UTRANWorld::coverage() const
{
    constexpr double ThreshHigh = 16; // dB
    const UTRANCell& cell = _cells[strongest()];
    const double margin = cell.rscp - UTRANThresholds::QRxLevMin;
    return {nameOf(cell), cell.rscp, margin, margin > ThreshHigh};
}

double UTRANWorld::servingMargin() const
{
    return srxlev();
}

CellName UTRANWorld::servingName() const
{
    return nameOf(servingCell());
}

bool UTRANWorld::isOnOwnChannel() const
{
    return _connection.isOnDedicatedChannel();
}

bool UTRANWorld::isSettled() const
{
    return true;
}

void UTRANWorld::arrive(Technology, MoveKind)
{
    _serving = strongest();
    _candidateFor = 0ms;
}

void UTRANWorld::leave()
{
    _connection.lose();
}

void UTRANWorld::setOthers(const Coverage&, const Coverage&) { }

} // namespace spectrel
