#include "Telephony/Simulator/LTE/LTERoad.h"

#include <array>
#include <cmath>

namespace spectrel {

namespace {

constexpr double SiteDistance = 500;
constexpr Valley SiteLess {2500, 4500, 16}; // the sites at both ends stand

constexpr OpenWater Water {1900, 2400}; // in front of the first site

constexpr double ResourceBlockElements = 12; // subcarriers of a resource block
constexpr double Noise = -125; // dBm in one subcarrier of 15 kHz, noise figure 7 dB
constexpr double Fading = 1.5; // dB, from one measurement to the next
constexpr double FilterGain = 0.25; // of a new measurement in the average

/// Each site has the first carrier and some have another.
constexpr std::array<LTELayer, 3> Layers {{
    {.band = 3,
        .downlinkChannel = 1300,
        .resourceBlocks = 100,
        .power = 18,
        .priority = 5,
        .qRxLevMin = -124,
        .pMax = 23,
        .sIntraSearch = 46,
        .sNonIntraSearch = 26,
        .threshHigh = 30,
        .threshLow = 8,
        .threshServingLow = 22},
    {.band = 20,
        .downlinkChannel = 6300,
        .resourceBlocks = 50,
        .power = 19,
        .priority = 4,
        .qRxLevMin = -122,
        .pMax = {},
        .sIntraSearch = 44,
        .sNonIntraSearch = {},
        .threshHigh = 26,
        .threshLow = 6,
        .threshServingLow = 18},
    {.band = 7,
        .downlinkChannel = 3350,
        .resourceBlocks = 75,
        .power = 15,
        .priority = 6,
        .qRxLevMin = -120,
        .pMax = 20,
        .sIntraSearch = {},
        .sNonIntraSearch = 30,
        .threshHigh = 32,
        .threshLow = 10,
        .threshServingLow = 24},
}};

constexpr std::array<OtherCell, 6> OtherCells {{
    {{ReselectionTechnology::UTRAN, 3, 10700, 311, 0}, 2950, 33, -115},
    {{ReselectionTechnology::UTRAN, 3, 10700, 118, 0}, 3900, 33, -115},
    {{ReselectionTechnology::GERAN, 1, 62, 0x2B, 0}, 3200, 43, -104},
    {{ReselectionTechnology::GERAN, 1, 612, 0x15, 1}, 4100, 43, -104},
    {{ReselectionTechnology::CDMA1xRTT, 1, 283, 168, 0}, 3500, 36, -108},
    {{ReselectionTechnology::CDMAHRPD, 2, 37, 300, 0}, 3500, 36, -108},
}};

double milliwatts(double dBm)
{
    return std::pow(10, dBm / 10);
}

double decibels(double milliwatts)
{
    return 10 * std::log10(milliwatts);
}

void filter(double& average, double measured)
{
    average += (measured - average) * FilterGain;
}

} // namespace

std::span<const LTELayer> LTERoad::layers()
{
    return Layers;
}

LTERoad::LTERoad(Dice& dice)
    : _otherCells(OtherCells.begin(), OtherCells.end())
{
    std::uint32_t site = 4096;
    for (double position = 0; position < Length; position += SiteDistance, ++site) {
        if (position <= SiteLess.from || position >= SiteLess.to)
            buildSite(site, position, dice);
    }
    for (std::size_t cell = 0; cell < _cells.size(); ++cell)
        _shadowing.emplace_back(dice);
}

void LTERoad::buildSite(std::uint32_t site, double position, Dice& dice)
{
    for (std::size_t number = 0; number < Layers.size(); ++number) {
        if (number > 0 && dice.between(0, 1) < 0.5)
            continue;
        const LTELayer& layer = Layers[number];
        LTECell cell;
        cell.identity = site << 8 | static_cast<std::uint32_t>(number + 1);
        cell.physicalCellId = static_cast<std::uint16_t>(dice.below(504));
        cell.band = layer.band;
        cell.downlinkChannel = layer.downlinkChannel;
        cell.uplinkChannel = static_cast<std::uint16_t>(cell.downlinkChannel + 18000);
        cell.resourceBlocks = layer.resourceBlocks;
        cell.antennas = number == 0 ? 4 : 2;
        cell.trackingArea = static_cast<std::uint16_t>(position < Length / 2 ? 1201 : 1202);
        cell.layer = &layer;
        cell.position = position + dice.between(-60, 60);
        cell.offset = dice.between(30, 120);
        cell.power = layer.power;
        cell.load = dice.between(0.3, 0.8);
        cell.frequencyOffset = static_cast<std::uint16_t>(dice.below(200));
        cell.frameOffset = static_cast<std::uint16_t>(dice.below(1024));
        cell.sampleOffset = dice.below(307200);
        _cells.push_back(cell);
    }
}

void LTERoad::advance(std::chrono::milliseconds step, const Journey& journey, Dice& dice)
{
    for (Shadowing& shadowing : _shadowing)
        shadowing.advance(step, dice);
    receive(journey, dice);
    const bool isFirst = step == step.zero();
    for (LTECell& cell : _cells) {
        const double rssi = carrierPower(*cell.layer);
        cell.measured = lteLevels(cell.measured.rsrp, rssi, cell.resourceBlocks);
        LTELevels average = isFirst ? cell.measured : cell.average;
        filter(average.rsrp, cell.measured.rsrp);
        filter(average.rssi, cell.measured.rssi);
        cell.average = lteLevels(average.rsrp, average.rssi, cell.resourceBlocks);
    }
}

void LTERoad::setOtherCells(const Coverage& utran, const Coverage& gsm)
{
    const auto cell = [](ReselectionTechnology technology, std::uint8_t priority, const Coverage& found) {
        const ReselectionCandidate candidate {technology, priority, static_cast<std::uint16_t>(found.cell.channel),
            static_cast<std::uint16_t>(found.cell.id), 0};
        const int qRxLevMin = static_cast<int>(found.level - found.margin);
        return OtherCell {candidate, 0, std::nullopt, qRxLevMin, found.level};
    };
    _otherCells = {cell(ReselectionTechnology::UTRAN, 3, utran), cell(ReselectionTechnology::GERAN, 1, gsm)};
}

void LTERoad::receive(const Journey& journey, Dice& dice)
{
    const double loss = SiteLess.lossAt(journey) + journey.tunnelLoss();
    for (std::size_t index = 0; index < _cells.size(); ++index) {
        LTECell& cell = _cells[index];
        const double distance = journey.distanceTo(cell.position, cell.offset);
        const double water = index == 0 ? Water.gainAt(journey) : 0;
        const double received = cell.power - pathLoss(distance) - loss + _shadowing[index].decibels() + water;
        cell.measured.rsrp = std::clamp(received + dice.between(-Fading, Fading), -139.0, -44.0);
    }
    for (OtherCell& cell : _otherCells) {
        if (!cell.power)
            continue;
        cell.level = *cell.power - pathLoss(journey.distanceTo(cell.position, 80)) - journey.tunnelLoss();
    }
}

/// The RSSI of a carrier: what all its cells send, and the noise, in all its resource blocks.
double LTERoad::carrierPower(const LTELayer& layer) const
{
    double element = milliwatts(Noise);
    for (const LTECell& cell : _cells) {
        if (cell.layer == &layer)
            element += cell.load * milliwatts(cell.measured.rsrp);
    }
    return decibels(element * ResourceBlockElements * layer.resourceBlocks);
}

} // namespace spectrel
