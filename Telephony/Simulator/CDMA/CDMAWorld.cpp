#include "Telephony/Simulator/CDMA/CDMAWorld.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::size_t Sites = 12;
constexpr double SiteDistance = 550; // metres
constexpr double SectorPower = 27; // dBm, antenna gains and what the car takes included
constexpr double Noise = -105; // dBm in 1.23 MHz, the receiver's own included
constexpr double Hysteresis = 2; // by which a pilot must be better to serve: 3 dB

// The active set (3GPP2 C.S0005, pilot set maintenance), by pilots' shares of the received power.
constexpr double AddShare = 0.2; // T_ADD, -14 dB of a pilot that is a fifth of its sector's power
constexpr double DropShare = 0.126; // T_DROP, -16 dB
constexpr std::chrono::milliseconds DropTime = 4s; // T_TDROP
constexpr std::size_t MaxActiveSet = 6;

// Of a sector's share in the received power.
constexpr double LostShare = 0.02; // below it even the pilot cannot be found
constexpr double FoundShare = 0.1;

double milliwatts(double decibels)
{
    return std::pow(10, decibels / 10);
}

double inDecibels(double ratio)
{
    return 10 * std::log10(ratio);
}

CDMASector sectorOf(std::size_t site)
{
    CDMASector sector;
    sector.system.pn = static_cast<std::uint16_t>(4 * ((11 + site * 37) % 128)); // neighbours far apart, PN_INC 4
    sector.system.isHome = site < Sites / 2;
    sector.system.systemId = sector.system.isHome ? 16420 : 16422;
    sector.system.networkId = static_cast<std::uint16_t>(1 + site / 4);
    sector.system.baseId = static_cast<std::uint16_t>(1601 + 16 * site);
    sector.system.packetZone = sector.system.isHome ? 7 : 8;
    return sector;
}

CellName oneXNameOf(const CDMASystem& system)
{
    return {"cdma", CDMACarriers::OneX, system.pn, system.baseId};
}

CellName evdoNameOf(const CDMASystem& system)
{
    return {"evdo", CDMACarriers::EVDO, system.pn, std::nullopt};
}

} // namespace

constexpr std::array<CDMAWorld::Phase, 6> CDMAWorld::UsualPhases {{
    {10s, Activity::Idle},
    {11s, Activity::DataSetup},
    {66s, Activity::Data},
    {72s, Activity::Idle},
    {114s, Activity::Voice},
    {120s, Activity::Idle},
}};

constexpr std::array<CDMAWorld::Phase, 2> CDMAWorld::BusyPhases {{
    {60s, Activity::Data},
    {120s, Activity::Voice},
}};

CDMAWorld::CDMAWorld(Scene scene, std::uint32_t seed)
    : _phases(scene == Scene::Handover ? std::span<const Phase>(BusyPhases) : std::span<const Phase>(UsualPhases))
    , _dice(seed)
    , _road(scene, Sites, SiteDistance, _dice)
    , _secondAntenna(_dice)
{
    for (std::size_t site = 0; site < Sites; ++site)
        _sectors.push_back(sectorOf(site));
    measure();
    _serving = _servingEVDO = best();
    _moves.first(oneXNameOf(serving()));
    _moves.first(evdoNameOf(serving()));
    maintainActiveSet({});
}

void CDMAWorld::advance(std::chrono::milliseconds step)
{
    _moves.begin();
    _elapsed += step;
    _road.advance(step, _dice);
    _secondAntenna.advance(step, _dice);
    measure();
    if (_isInService && shareOf(servingSector()) < LostShare)
        _isInService = false;
    if (_isInService)
        reselect();
    else
        searchService();
    if (_isInService)
        followWithEVDO();
    maintainActiveSet(step);
    // The weaker the pilots, the less power control can hold the one broken frame in a hundred.
    const double active = inDecibels(shareOf(servingSector()));
    _isFrameBad = _dice.between(0, 1) < 0.01 + std::max(0.0, -4 - active) * 0.02;
    if (activity() == Activity::Data)
        _traffic.advance(step, inDecibels(servingSignal()), transmitted(), _dice);
    if (_elapsed % 1s == 0s) {
        _second = static_cast<std::uint32_t>(_elapsed / 1s);
        _countsAtSecond = _traffic.counts();
    }
}

void CDMAWorld::measure()
{
    _total = milliwatts(Noise);
    for (std::size_t mast = 0; mast < _sectors.size(); ++mast) {
        _sectors[mast].power = milliwatts(SectorPower - _road.loss(mast));
        _total += _sectors[mast].power;
    }
}

void CDMAWorld::reselect()
{
    const bool isTalking = activity() == Activity::Voice;
    if (const std::size_t next = best(); next != _serving)
        serve(next, isTalking ? ByHandover : byReselection(ReselectionRule::EqualPriority));
}

void CDMAWorld::searchService()
{
    const std::size_t found = best();
    if (shareOf(_sectors[found]) < FoundShare)
        return;
    _isInService = true;
    if (found != _serving)
        serve(found, AfterServiceLost);
    if (activity() == Activity::Voice || _servingEVDO == _serving)
        return;
    _moves.moved(evdoNameOf(_sectors[_servingEVDO].system), evdoNameOf(serving()), AfterServiceLost);
    _servingEVDO = _serving;
}

void CDMAWorld::serve(std::size_t sector, MoveCause cause)
{
    _moves.moved(oneXNameOf(serving()), oneXNameOf(_sectors[sector].system), cause);
    _serving = sector;
}

/// EV-DO has the same sector, but sleeps while the phone talks; after that it finds the pilot anew.
void CDMAWorld::followWithEVDO()
{
    if (activity() == Activity::Voice || _servingEVDO == _serving)
        return;
    _moves.moved(evdoNameOf(_sectors[_servingEVDO].system), evdoNameOf(serving()),
        activity() == Activity::Data ? ByHandover : byReselection(ReselectionRule::EqualPriority));
    _servingEVDO = _serving;
}

std::size_t CDMAWorld::best() const
{
    const auto strongest =
        static_cast<std::size_t>(std::ranges::max_element(_sectors, {}, &CDMASector::power) - _sectors.begin());
    return _sectors[strongest].power > Hysteresis * _sectors[_serving].power ? strongest : _serving;
}

void CDMAWorld::maintainActiveSet(std::chrono::milliseconds step)
{
    auto size = static_cast<std::size_t>(std::ranges::count(_sectors, true, &CDMASector::isActive));
    for (CDMASector& sector : _sectors) {
        const double share = shareOf(sector);
        sector.weakFor = share < DropShare ? sector.weakFor + step : 0ms;
        const bool isDropped = sector.isActive && sector.weakFor >= DropTime;
        const bool isAdded = !sector.isActive && share > AddShare && size < MaxActiveSet;
        if (isDropped || isAdded) {
            sector.isActive = isAdded;
            size += isAdded ? 1 : -1;
        }
    }
}

CDMAWorld::Activity CDMAWorld::activity() const
{
    if (!_isInService)
        return Activity::Idle;
    const auto now = _elapsed % _phases.back().end;
    return std::ranges::find_if(_phases, [now](const Phase& phase) { return now < phase.end; })->activity;
}

bool CDMAWorld::isAwake() const
{
    return _elapsed % 5s < 1s;
}

std::vector<CDMAPilot> CDMAWorld::activePilots() const
{
    std::vector<CDMAPilot> pilots {{serving().pn, shareOf(servingSector())}};
    if (activity() == Activity::Idle)
        return pilots;
    for (const CDMASector& sector : _sectors) {
        if (sector.isActive && sector.system.pn != serving().pn)
            pilots.push_back({sector.system.pn, shareOf(sector)});
    }
    pilots.resize(std::min(pilots.size(), MaxActiveSet), pilots.front());
    return pilots;
}

double CDMAWorld::received() const
{
    return inDecibels(_total);
}

double CDMAWorld::receivedBySecond() const
{
    return received() - 1 + _secondAntenna.decibels() / 2;
}

double CDMAWorld::transmitted() const
{
    constexpr double OpenLoop = -76; // dB: sum of received and transmitted power (3GPP2 C.S0011, band class 1)
    return std::clamp(OpenLoop - received(), -50.0, 23.0);
}

double CDMAWorld::servingSignal() const
{
    constexpr double OwnNoise = 0.02; // of the pilot's power, by filters and echoes: 17 dB at best
    return servingSector().power / (_total - (1 - OwnNoise) * servingSector().power);
}

CDMAReport CDMAWorld::report() const
{
    return {activity(), isAwake(), _isInService, serving(), activePilots(), received(), receivedBySecond(),
        transmitted(), servingSignal(), isFrameBad(), second(), countsAtSecond()};
}

} // namespace spectrel
