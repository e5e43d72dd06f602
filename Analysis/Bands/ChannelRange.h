#pragma once

#include "Analysis/Bands/Bands.h"

#include <cstdint>
#include <span>
#include <string_view>

namespace spectrel {

/// A frequency in hertz: the standards' frequencies are whole multiples of 500 Hz, so sums stay exact.
using Hertz = std::int64_t;

/// Of a constant written as in the standards.
constexpr Hertz hertz(double mhz)
{
    return static_cast<Hertz>(mhz * 1e6 + (mhz < 0 ? -0.5 : 0.5));
}

/// Channels of one band with even steps between their numbers and frequencies. A band whose channels do not follow one
/// another evenly has several ranges.
struct ChannelRange {
    /// One direction: the n-th channel from 0 has the number `first + n × step`.
    struct Side {
        std::uint32_t first = 0;
        std::uint32_t count = 0; // 0: there is no such direction
        Hertz firstFrequency = 0;
    };

    std::string_view band;
    std::string_view name;
    Duplex duplex = Duplex::FDD;
    Side downlink;
    Side uplink; // its n-th channel is the pair of the downlink's n-th, as far as it goes
    Hertz spacing = 0; // from one channel to the next
    std::uint32_t step = 1; // from one channel's number to the next
};

/// The tables, in the standards' order; all ranges of a band stand together.
std::span<const ChannelRange> eutraRanges();
std::span<const ChannelRange> utraFDDRanges();
std::span<const ChannelRange> utraTDDRanges();
std::span<const ChannelRange> gsmRanges();
std::span<const ChannelRange> cdmaRanges();

} // namespace spectrel
