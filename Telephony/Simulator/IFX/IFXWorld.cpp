#include "Telephony/Simulator/IFX/IFXWorld.h"

#include <algorithm>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::size_t Sites = 10;
constexpr double SiteDistance = 700; // metres
constexpr double CellPower = 33; // dBm; the path loss at 900 MHz is some 10 dB below that of the formula
constexpr double Hysteresis = 4; // dB by which a cell must be better
constexpr double Sensitivity = -104; // dBm
constexpr double Weakest = -110; // dBm, the lower end of RXLEV: nothing is heard
constexpr std::size_t MaxNeighbours = 6; // that a phone measures at once (3GPP TS 45.008, 7.1)

constexpr std::chrono::milliseconds Round = 120s;
constexpr std::chrono::milliseconds CallStart = 30s; // in each round
constexpr std::chrono::milliseconds CallEnd = 85s;

CellName nameOf(const IFXCell& cell)
{
    return {"gsm", cell.channel, cell.networkColour * 8u + cell.stationColour, cell.identity};
}

} // namespace

IFXWorld::IFXWorld(Scene scene, std::uint32_t seed)
    : _isAlwaysTalking(scene == Scene::Handover)
    , _dice(seed)
    , _road(scene, Sites, SiteDistance, _dice)
{
    for (std::size_t site = 0; site < Sites; ++site) {
        IFXCell cell;
        cell.channel = static_cast<std::uint16_t>(12 + site * 47 % 100); // neighbours far apart
        cell.networkColour = 3;
        cell.stationColour = static_cast<std::uint8_t>(_dice.below(8));
        cell.locationArea = site < Sites / 2 ? 1201 : 1202;
        cell.routingArea = site < Sites / 2 ? 1 : 2;
        cell.identity = static_cast<std::uint16_t>(20010 + 10 * site);
        _cells.push_back(cell);
    }
    measure();
    _serving = strongest();
    _moves.first(nameOf(serving()));
}

void IFXWorld::advance(std::chrono::milliseconds step)
{
    const double seconds = std::chrono::duration<double>(step).count();
    _moves.begin();
    _elapsed += step;
    _road.advance(step, _dice);
    measure();
    reselect();
    const double margin = serving().level - Sensitivity;
    _quality = static_cast<unsigned>(std::clamp((20 - margin) / 3 + _dice.between(-0.5, 1), 0.0, 7.0));
    if (!isTalking()) { // one at a time: class B
        _received += 25'000 * seconds * _dice.between(0, 1);
        _sent += 4'000 * seconds * _dice.between(0, 1);
    }
}

void IFXWorld::reselect()
{
    const std::size_t best = strongest();
    if (_isInService && serving().level <= Weakest)
        _isInService = false;
    if (!_isInService && _cells[best].level < Sensitivity)
        return;
    const bool wasInService = _isInService;
    _isInService = true;
    if (_cells[best].level <= serving().level + Hysteresis)
        return;
    const MoveCause inService = isTalking() ? ByHandover : byReselection(ReselectionRule::EqualPriority);
    _moves.moved(nameOf(serving()), nameOf(_cells[best]), wasInService ? inService : AfterServiceLost);
    _serving = best;
    ++_cellsVisited;
}

void IFXWorld::measure()
{
    for (std::size_t mast = 0; mast < _cells.size(); ++mast)
        _cells[mast].level = std::clamp(CellPower - _road.loss(mast), Weakest, -48.0);
}

std::size_t IFXWorld::strongest() const
{
    return static_cast<std::size_t>(std::ranges::max_element(_cells, {}, &IFXCell::level) - _cells.begin());
}

std::vector<IFXCell> IFXWorld::neighbours() const
{
    std::vector<IFXCell> others;
    for (std::size_t cell = 0; cell < _cells.size(); ++cell) {
        if (cell != _serving && _cells[cell].level > Sensitivity)
            others.push_back(_cells[cell]);
    }
    std::ranges::stable_sort(others, std::ranges::greater(), &IFXCell::level);
    others.resize(std::min(others.size(), MaxNeighbours));
    return others;
}

bool IFXWorld::isTalking() const
{
    const auto now = _elapsed % Round;
    if (!_isInService || _isAlwaysTalking)
        return _isInService;
    return now >= CallStart && now < CallEnd;
}

std::chrono::seconds IFXWorld::talkingFor() const
{
    if (_isAlwaysTalking)
        return std::chrono::duration_cast<std::chrono::seconds>(_elapsed);
    return isTalking() ? std::chrono::duration_cast<std::chrono::seconds>(_elapsed % Round - CallStart) : 0s;
}

unsigned IFXWorld::timingAdvance() const
{
    return static_cast<unsigned>(std::clamp(_road.distance(_serving) / 554, 0.0, 63.0));
}

IFXReport IFXWorld::report() const
{
    return {_isInService, serving(), neighbours(), isTalking(), talkingFor(), quality(), timingAdvance(),
        cellsVisited(), bytesReceived(), bytesSent()};
}

} // namespace spectrel
