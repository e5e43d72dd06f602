#include "Analysis/Bands/ChannelRange.h"

#include <array>

namespace spectrel {

namespace {

constexpr Hertz Spacing = hertz(0.2); // TS 45.005, clause 2

/// One number serves both ways: the uplink's first frequency, and how far above it the downlink is.
constexpr ChannelRange range(std::string_view band, std::string_view name, std::uint32_t first, std::uint32_t last,
    double uplinkMHz, double separation)
{
    const std::uint32_t count = last - first + 1;
    return {band, name, Duplex::FDD, {first, count, hertz(uplinkMHz) + hertz(separation)},
        {first, count, hertz(uplinkMHz)}, Spacing};
}

constexpr std::string_view Extended = "900 MHz (extended)";

/// TS 45.005, clause 2. Each number of the 900 MHz bands stands with the narrowest of them that has it: the wider bands
/// hold the numbers of the narrower, at the same frequencies. 512 to 810 mean two frequencies, and only the network
/// knows which.
constexpr std::array Ranges {
    range("P-GSM 900", "900 MHz (primary)", 1, 124, 890.2, 45),
    range("E-GSM 900", Extended, 0, 0, 890, 45),
    range("E-GSM 900", Extended, 975, 1023, 880.2, 45),
    range("R-GSM 900", "900 MHz (railways)", 955, 974, 876.2, 45),
    range("GSM 850", "850 MHz", 128, 251, 824.2, 45),
    range("DCS 1800", "1800 MHz", 512, 885, 1710.2, 95),
    range("PCS 1900", "1900 MHz (PCS)", 512, 810, 1850.2, 80),
};

} // namespace

std::span<const ChannelRange> gsmRanges()
{
    return Ranges;
}

} // namespace spectrel
