#include "Telephony/Simulator/CDMA/EVDOTraffic.h"

#include <algorithm>

namespace spectrel {

namespace {

constexpr double SlotsASecond = 600;
constexpr double SubframesASecond = 50; // of one interlace
constexpr double LossRate = 0.01;
constexpr double SmallPacketRate = 0.1; // what is left at the end of a burst

constexpr double bitsPerSlot(const ForwardFormat& format)
{
    return static_cast<double>(format.bits) / format.slots;
}

/// The fastest format that the signal carries; the first one when it carries none.
std::size_t bestFormat(double signal)
{
    std::size_t best = 0;
    for (std::size_t format = 0; format < ForwardFormats.size(); ++format) {
        if (ForwardFormats[format].signal <= signal
            && bitsPerSlot(ForwardFormats[format]) >= bitsPerSlot(ForwardFormats[best]))
            best = format;
    }
    return best;
}

/// The format or, where its data rate has smaller packets, at times one of those.
std::size_t formatToFill(std::size_t format, Dice& dice)
{
    const bool hasSmaller = format > 0 && ForwardFormats[format - 1].drc == ForwardFormats[format].drc;
    return hasSmaller && dice.between(0, 1) < SmallPacketRate ? format - 1 : format;
}

} // namespace

void EVDOTraffic::advance(std::chrono::milliseconds step, double signal, double power, Dice& dice)
{
    const double seconds = std::chrono::duration<double>(step).count();
    advanceForward(SlotsASecond * seconds * dice.between(0.3, 0.9), signal, dice);
    advanceReverse(SubframesASecond * seconds, power, dice);
}

void EVDOTraffic::advanceForward(double slots, double signal, Dice& dice)
{
    const std::size_t best = bestFormat(signal);
    for (_slots += slots; _slots >= ForwardFormats[best].slots; _slots -= ForwardFormats[best].slots) {
        const std::size_t format = formatToFill(best, dice);
        if (dice.between(0, 1) < LossRate) {
            ++_counts.forwardLost[ForwardFormats[format].drc];
        } else {
            ++_counts.forward[format];
            _counts.forwardBits += ForwardFormats[format].bits;
        }
    }
}

/// The louder the phone has to speak already, the smaller the packets that it has power for.
void EVDOTraffic::advanceReverse(double subframes, double power, Dice& dice)
{
    constexpr std::size_t Subpackets = 4;
    constexpr double DecibelsAPayload = 3;
    const auto payload = static_cast<std::size_t>(std::clamp((23 - power) / DecibelsAPayload, 0.0, 11.0));
    for (std::size_t interlace = 0; interlace < EVDOCounts::Interlaces; ++interlace) {
        double& left = _subframes[interlace];
        for (left += subframes; left >= Subpackets;) {
            const std::uint32_t needed = dice.below(Subpackets);
            ReversePackets& packets = _counts.reverse[interlace][dice.below(EVDOCounts::Modes)][payload];
            left -= needed + 1;
            if (dice.between(0, 1) < LossRate) {
                ++packets.lost;
            } else {
                ++packets.arrived[needed];
                _counts.reverseBits += ReversePayloads[payload];
            }
        }
    }
}

} // namespace spectrel
