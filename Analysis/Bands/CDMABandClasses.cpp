#include "Analysis/Bands/ChannelRange.h"

#include <array>

namespace spectrel {

namespace {

/// One number serves both ways: the first and last number, the mobile station's and the base station's first frequency,
/// and the spacing.
constexpr ChannelRange range(std::string_view band, std::string_view name, std::uint32_t first, std::uint32_t last,
    double mobileMHz, double baseMHz, double spacingMHz)
{
    const std::uint32_t count = last - first + 1;
    return {
        band, name, Duplex::FDD, {first, count, hertz(baseMHz)}, {first, count, hertz(mobileMHz)}, hertz(spacingMHz)};
}

constexpr ChannelRange baseOnly(std::string_view band, std::string_view name, std::uint32_t first, std::uint32_t last,
    double baseMHz, double spacingMHz)
{
    return {band, name, Duplex::SDL, {first, last - first + 1, hertz(baseMHz)}, {}, hertz(spacingMHz)};
}

constexpr std::string_view Cellular = "800 MHz (cellular)";
constexpr std::string_view TACS = "900 MHz (TACS)";
constexpr std::string_view JTACS = "800 MHz (JTACS)";
constexpr std::string_view NMT = "450 MHz (NMT)";
constexpr std::string_view Secondary800 = "800 MHz (secondary)";
constexpr std::string_view PAMR = "400 MHz (PAMR)";

/// 3GPP2 C.S0057, clause 2: "CDMA channel number to CDMA frequency assignment correspondence" of each band class.
constexpr std::array Ranges {
    range("0", Cellular, 1, 799, 825.03, 870.03, 0.03),
    range("0", Cellular, 991, 1023, 824.04, 869.04, 0.03),
    range("0", Cellular, 1024, 1323, 815.04, 860.04, 0.03),
    range("1", "1900 MHz (PCS)", 0, 1199, 1850, 1930, 0.05),
    range("2", TACS, 0, 1000, 889.9875, 934.9875, 0.025),
    range("2", TACS, 1329, 2047, 872.0125, 917.0125, 0.025),
    range("3", JTACS, 1, 799, 915.0125, 860.0125, 0.0125),
    range("3", JTACS, 801, 1039, 898.0125, 843.0125, 0.0125),
    range("3", JTACS, 1041, 1199, 887.0125, 832.0125, 0.0125),
    range("3", JTACS, 1201, 1600, 893.0125, 838.0125, 0.0125),
    range("4", "1800 MHz (Korean PCS)", 0, 599, 1750, 1840, 0.05),
    range("5", NMT, 1, 400, 450, 460, 0.025),
    range("5", NMT, 472, 871, 410, 420, 0.025),
    range("5", NMT, 1039, 1473, 451.31, 461.31, 0.02),
    range("5", NMT, 1536, 1715, 479, 489, 0.025),
    range("5", NMT, 1792, 2016, 479, 489, 0.02),
    range("6", "2100 MHz", 0, 1199, 1920, 2110, 0.05),
    range("7", "700 MHz (upper)", 0, 240, 776, 746, 0.05),
    range("8", "1800 MHz", 0, 1499, 1710, 1805, 0.05),
    range("9", "900 MHz", 0, 699, 880, 925, 0.05),
    range("10", Secondary800, 0, 719, 806, 851, 0.025),
    range("10", Secondary800, 720, 919, 896, 935, 0.025),
    range("11", PAMR, 1, 400, 450, 460, 0.025),
    range("11", PAMR, 472, 871, 410, 420, 0.025),
    range("11", PAMR, 1536, 1715, 479, 489, 0.025),
    range("12", "800 MHz (PAMR)", 0, 239, 870.0125, 915.0125, 0.025),
    range("13", "2600 MHz", 0, 1399, 2500, 2620, 0.05),
    range("14", "1900 MHz (extended PCS)", 0, 1299, 1850, 1930, 0.05),
    range("15", "1700/2100 MHz (AWS)", 0, 899, 1710, 2110, 0.05),
    range("16", "2500 MHz (US)", 140, 1459, 2502, 2624, 0.05),
    baseOnly("17", "2500 MHz (US, forward link)", 140, 1459, 2624, 0.05),
    range("18", "700 MHz (public safety)", 0, 240, 787, 757, 0.05),
    range("19", "700 MHz (lower)", 0, 360, 698, 728, 0.05),
    range("20", "1600 MHz (L band)", 0, 680, 1626.5, 1525, 0.05),
    range("21", "2000 MHz (S band)", 0, 399, 2000, 2180, 0.05),
};

} // namespace

std::span<const ChannelRange> cdmaRanges()
{
    return Ranges;
}

} // namespace spectrel
