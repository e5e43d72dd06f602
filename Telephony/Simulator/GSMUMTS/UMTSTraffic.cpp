#include "Telephony/Simulator/GSMUMTS/UMTSTraffic.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr auto Window = 1s;
constexpr std::uint16_t WindowFrames = 100; // radio frames in it
constexpr std::size_t PowerSamples = 5;

constexpr double MaxPower = 24; // dBm, power class 3 (3GPP TS 25.101, table 6.1)
constexpr double MinPower = -50; // table 6.4
constexpr double PowerAtNodeB = -108; // dBm, which the power control aims at

constexpr std::uint8_t SignallingChannel = 24; // transport channel identities
constexpr std::uint8_t VoiceChannel = 1;
constexpr std::uint32_t VoiceBlocks = 5; // a step: every 20 ms

constexpr std::uint32_t Processes = 6; // HARQ
constexpr std::uint32_t SubFrames = 50; // a step

/// Transport block sizes by quality indicator 1 to 30 (3GPP TS 25.214, table 7D).
constexpr std::array<std::uint32_t, 30> BlockSizes {137, 173, 233, 317, 377, 461, 650, 792, 931, 1262, 1483, 1742, 2279,
    2583, 3319, 3565, 4189, 4664, 5287, 5887, 6554, 7168, 9719, 11418, 14411, 17237, 21754, 23370, 24222, 25558};

/// The indicator a phone would send: 26 at -4 dB, a step a dB.
std::uint32_t blockSize(double ecno)
{
    return BlockSizes[static_cast<std::size_t>(std::clamp(std::lround(ecno) + 30, 1L, 30L) - 1)];
}

/// Of the dedicated channel: 1 %, as the power control wants it, until the signal is too weak.
double blockErrorRate(double ecno)
{
    return std::clamp(0.01 * std::pow(10, std::max(-11 - ecno, 0.0) / 4), 0.01, 0.6);
}

} // namespace

void UMTSTraffic::advance(std::chrono::milliseconds step, const UMTSReceiver& umts, const Demand& demand, Dice& dice)
{
    if (_inWindow >= Window) {
        _inWindow = 0ms;
        _blocks.channels.clear();
        _hsdpa = {};
    }
    _inWindow += step;
    _received = 0;
    samplePower(umts, dice);
    countBlocks(umts, demand, dice);
    countHSDPA(umts, demand, dice);
}

void UMTSTraffic::samplePower(const UMTSReceiver& umts, Dice& dice)
{
    std::optional<double> power;
    const bool sends = umts.isOn() && (umts.state() == RRCState::CellDCH || umts.state() == RRCState::CellFACH);
    const double gap = dice.between(0, 1);
    const double control = dice.between(-1, 1);
    if (sends && gap > 0.1) { // every tenth sample falls into a measurement gap
        const double loss = umts.servingCell().power - umts.servingCell().rscp;
        power = std::clamp(PowerAtNodeB + loss + control, MinPower, MaxPower);
    }
    _powers.push_back(power);
    if (_powers.size() > PowerSamples)
        _powers.erase(_powers.begin());
}

void UMTSTraffic::countBlocks(const UMTSReceiver& umts, const Demand& demand, Dice& dice)
{
    _blocks.window = WindowFrames;
    if (umts.state() != RRCState::CellDCH)
        return _blocks.channels.clear();
    if (_blocks.channels.empty())
        _blocks.channels.push_back({SignallingChannel, 0, 0});
    if (demand.call && _blocks.channels.size() < 2)
        _blocks.channels.push_back({VoiceChannel, 0, 0});
    const double rate = blockErrorRate(umts.servingCell().ecno);
    for (TransportChannelBlocks& channel : _blocks.channels) {
        const std::uint32_t blocks = channel.identity == VoiceChannel ? VoiceBlocks : 2 + dice.below(2);
        _wrongOwed += rate * blocks * dice.between(0, 2);
        const auto wrong = std::min(static_cast<std::uint32_t>(_wrongOwed), blocks);
        _wrongOwed -= wrong;
        channel.received += blocks;
        channel.wrong += wrong;
    }
}

void UMTSTraffic::countHSDPA(const UMTSReceiver& umts, const Demand& demand, Dice& dice)
{
    if (umts.state() != RRCState::CellDCH || !demand.transfer)
        return;
    const UMTSCell& cell = umts.servingCell();
    if (_hsdpa.carriers != cell.carriers)
        _hsdpa = {}; // another cell's
    _hsdpa.carriers = cell.carriers;
    _hsdpa.subFrames = static_cast<std::uint16_t>(_hsdpa.subFrames + SubFrames);
    countCarrier(_hsdpa.primary, cell.ecno, dice);
    if (cell.carriers != HSDPACarriers::Single)
        countCarrier(_hsdpa.secondary, cell.ecno - 2, dice);
}

void UMTSTraffic::countCarrier(std::vector<HARQProcess>& processes, double ecno, Dice& dice)
{
    if (processes.empty()) {
        for (std::uint8_t identity = 0; identity < Processes; ++identity)
            processes.push_back({identity, 0, 0, 0});
    }
    const std::uint32_t size = blockSize(ecno);
    for (HARQProcess& process : processes) {
        const std::uint32_t scheduled = SubFrames / Processes - dice.below(5);
        const std::uint32_t wrong = dice.below(2); // one in ten to twelve, as the network aims at
        process.newTransmissions = static_cast<std::uint16_t>(process.newTransmissions + scheduled);
        process.blockErrors = static_cast<std::uint16_t>(process.blockErrors + wrong);
        process.bits += (scheduled - wrong) * size;
        _received += (scheduled - wrong) * size;
    }
}

} // namespace spectrel
