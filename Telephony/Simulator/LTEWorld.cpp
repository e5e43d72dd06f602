#include "Telephony/Simulator/LTEWorld.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace spectrel {

namespace {

constexpr double RoadLength = 6000; // metres, a ring
constexpr double SiteDistance = 500;
constexpr double Hysteresis = 3; // dB by which a cell must be better...
constexpr std::chrono::milliseconds TimeToTrigger {640}; // ... for this long (3GPP TS 36.331, TimeToTrigger)

struct Layer {
    std::uint8_t band;
    std::uint16_t downlinkChannel;
    std::uint8_t resourceBlocks;
    double power; // dBm a resource element
};

/// Carriers of one network; each site has the first and some have another.
constexpr std::array<Layer, 3> Layers {{{3, 1300, 100, 18}, {20, 6300, 50, 19}, {7, 3350, 75, 15}}};

/// Distance on the ring.
double alongRing(double from, double to)
{
    const double direct = std::fabs(from - to);
    return std::min(direct, RoadLength - direct);
}

/// Path loss in dB at a distance in metres (3GPP TR 36.942, macro cell, urban: 128.1 + 37.6 lg(d/km)).
double pathLoss(double metres)
{
    return 128.1 + 37.6 * std::log10(std::max(metres, 35.0) / 1000);
}

} // namespace

LTEWorld::LTEWorld(std::uint32_t seed)
    : _random(seed)
{
    buildRoad();
    _shadowing.resize(_cells.size());
    for (double& decibels : _shadowing)
        decibels = random(-4, 4);
    _position = random(0, RoadLength);
    measure();
    const auto strongest =
        std::ranges::max_element(_cells, [](const LTECell& a, const LTECell& b) { return a.rsrp < b.rsrp; });
    _serving = static_cast<std::size_t>(strongest - _cells.begin());
    _candidate = _serving;
}

/// The generator's raw numbers, so that every library draws the same drive.
double LTEWorld::random(double from, double to)
{
    return from + (to - from) * static_cast<double>(_random()) / static_cast<double>(std::mt19937::max());
}

void LTEWorld::buildRoad()
{
    std::uint32_t site = 4096;
    for (double position = 0; position < RoadLength; position += SiteDistance, ++site) {
        for (std::size_t layer = 0; layer < Layers.size(); ++layer) {
            if (layer > 0 && random(0, 1) < 0.5)
                continue;
            LTECell cell;
            cell.identity = site << 8 | static_cast<std::uint32_t>(layer + 1);
            cell.physicalCellId = static_cast<std::uint16_t>(_random() % 504);
            cell.band = Layers[layer].band;
            cell.downlinkChannel = Layers[layer].downlinkChannel;
            cell.uplinkChannel = static_cast<std::uint16_t>(cell.downlinkChannel + 18000);
            cell.resourceBlocks = Layers[layer].resourceBlocks;
            cell.antennas = layer == 0 ? 4 : 2;
            cell.trackingArea = static_cast<std::uint16_t>(position < RoadLength / 2 ? 1201 : 1202);
            cell.position = position + random(-60, 60);
            cell.offset = random(30, 120);
            cell.power = Layers[layer].power;
            _cells.push_back(cell);
        }
    }
}

void LTEWorld::advance(std::chrono::milliseconds step)
{
    const double seconds = std::chrono::duration<double>(step).count();
    _speed = std::clamp(_speed + random(-1, 1) * seconds, 6.0, 22.0);
    _position = std::fmod(_position + _speed * seconds, RoadLength);
    for (double& decibels : _shadowing)
        decibels = std::clamp(decibels + random(-1, 1) * std::sqrt(seconds), -6.0, 6.0);
    measure();
    reselect(step);
    const double quality = std::clamp((servingCell().rsrp + 115) / 45, 0.02, 1.0);
    _received += 2.5e6 * quality * seconds * random(0.2, 1);
    _sent += 2.0e5 * quality * seconds * random(0.2, 1);
}

void LTEWorld::measure()
{
    for (std::size_t index = 0; index < _cells.size(); ++index) {
        LTECell& cell = _cells[index];
        const double metres = std::hypot(alongRing(_position, cell.position), cell.offset);
        const double shadowing = index < _shadowing.size() ? _shadowing[index] : 0;
        cell.rsrp = std::clamp(cell.power - pathLoss(metres) + shadowing, -140.0, -44.0);
    }
}

void LTEWorld::reselect(std::chrono::milliseconds step)
{
    const auto best = static_cast<std::size_t>(std::ranges::max_element(_cells, [](const LTECell& a, const LTECell& b) {
        return a.rsrp < b.rsrp;
    }) - _cells.begin());
    if (best == _serving || _cells[best].rsrp < _cells[_serving].rsrp + Hysteresis) {
        _candidateFor = {};
        return;
    }
    _candidateFor = best == _candidate ? _candidateFor + step : step;
    _candidate = best;
    if (_candidateFor >= TimeToTrigger) {
        _serving = best;
        _candidateFor = {};
    }
}

std::vector<const LTECell*> LTEWorld::neighbours(std::size_t atMost) const
{
    std::vector<const LTECell*> others;
    for (std::size_t index = 0; index < _cells.size(); ++index) {
        if (index != _serving)
            others.push_back(&_cells[index]);
    }
    std::ranges::sort(others, [](const LTECell* a, const LTECell* b) { return a->rsrp > b->rsrp; });
    others.resize(std::min(others.size(), atMost));
    return others;
}

} // namespace spectrel
