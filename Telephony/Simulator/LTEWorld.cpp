#include "Telephony/Simulator/LTEWorld.h"

#include <algorithm>
#include <array>

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

} // namespace

LTEWorld::LTEWorld(Scene scene, std::uint32_t seed)
    : _dice(seed)
    , _journey(scene, RoadLength, _dice)
{
    buildRoad();
    for (std::size_t cell = 0; cell < _cells.size(); ++cell)
        _shadowing.emplace_back(_dice);
    measure();
    const auto strongest =
        std::ranges::max_element(_cells, [](const LTECell& a, const LTECell& b) { return a.rsrp < b.rsrp; });
    _serving = static_cast<std::size_t>(strongest - _cells.begin());
    _candidate = _serving;
}

void LTEWorld::buildRoad()
{
    std::uint32_t site = 4096;
    for (double position = 0; position < RoadLength; position += SiteDistance, ++site) {
        for (std::size_t layer = 0; layer < Layers.size(); ++layer) {
            if (layer > 0 && _dice.between(0, 1) < 0.5)
                continue;
            LTECell cell;
            cell.identity = site << 8 | static_cast<std::uint32_t>(layer + 1);
            cell.physicalCellId = static_cast<std::uint16_t>(_dice.below(504));
            cell.band = Layers[layer].band;
            cell.downlinkChannel = Layers[layer].downlinkChannel;
            cell.uplinkChannel = static_cast<std::uint16_t>(cell.downlinkChannel + 18000);
            cell.resourceBlocks = Layers[layer].resourceBlocks;
            cell.antennas = layer == 0 ? 4 : 2;
            cell.trackingArea = static_cast<std::uint16_t>(position < RoadLength / 2 ? 1201 : 1202);
            cell.position = position + _dice.between(-60, 60);
            cell.offset = _dice.between(30, 120);
            cell.power = Layers[layer].power;
            _cells.push_back(cell);
        }
    }
}

void LTEWorld::advance(std::chrono::milliseconds step)
{
    const double seconds = std::chrono::duration<double>(step).count();
    _journey.advance(step, _dice);
    for (Shadowing& shadowing : _shadowing)
        shadowing.advance(step, _dice);
    measure();
    reselect(step);
    const double quality = std::clamp((servingCell().rsrp + 115) / 45, 0.02, 1.0);
    _received += 2.5e6 * quality * seconds * _dice.between(0.2, 1);
    _sent += 2.0e5 * quality * seconds * _dice.between(0.2, 1);
}

void LTEWorld::measure()
{
    for (std::size_t index = 0; index < _cells.size(); ++index) {
        LTECell& cell = _cells[index];
        const double loss = pathLoss(_journey.distanceTo(cell.position, cell.offset));
        cell.rsrp = std::clamp(cell.power - loss + _shadowing[index].decibels(), -140.0, -44.0);
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
