#include "Analysis/Bands/ChannelRange.h"

#include <array>

namespace spectrel {

namespace {

constexpr Hertz Raster = hertz(0.1); // TS 36.101, 5.7.2

/// Both directions of a band: F_low, N_Offs and the end of the range of N, downlink and uplink.
constexpr ChannelRange fdd(std::string_view band, std::string_view name, double downlinkMHz,
    std::uint32_t downlinkFirst, std::uint32_t downlinkLast, double uplinkMHz, std::uint32_t uplinkFirst,
    std::uint32_t uplinkLast)
{
    return {band, name, Duplex::FDD, {downlinkFirst, downlinkLast - downlinkFirst + 1, hertz(downlinkMHz)},
        {uplinkFirst, uplinkLast - uplinkFirst + 1, hertz(uplinkMHz)}, Raster};
}

constexpr ChannelRange sdl(
    std::string_view band, std::string_view name, double mhz, std::uint32_t first, std::uint32_t last)
{
    return {band, name, Duplex::SDL, {first, last - first + 1, hertz(mhz)}, {}, Raster};
}

constexpr ChannelRange tdd(
    std::string_view band, std::string_view name, double mhz, std::uint32_t first, std::uint32_t last)
{
    const ChannelRange::Side side {first, last - first + 1, hertz(mhz)};
    return {band, name, Duplex::TDD, side, side, Raster};
}

/// TS 36.101 Release 16, table 5.7.3-1 (channel numbers), with the operating bands of table 5.5-1. The uplinks of bands
/// 66 and 70 are narrower than their downlinks. 252 and 255 stand at the end of the range of E-ARFCNs: supplemental
/// downlinks in the 5 GHz band, whose numbers came with LTE in unlicensed spectrum.
constexpr std::array Ranges {
    fdd("1", "2100 MHz", 2110, 0, 599, 1920, 18000, 18599),
    fdd("2", "1900 MHz (PCS)", 1930, 600, 1199, 1850, 18600, 19199),
    fdd("3", "1800 MHz", 1805, 1200, 1949, 1710, 19200, 19949),
    fdd("4", "1700/2100 MHz (AWS-1)", 2110, 1950, 2399, 1710, 19950, 20399),
    fdd("5", "850 MHz", 869, 2400, 2649, 824, 20400, 20649),
    fdd("6", "850 MHz (Japan)", 875, 2650, 2749, 830, 20650, 20749),
    fdd("7", "2600 MHz", 2620, 2750, 3449, 2500, 20750, 21449),
    fdd("8", "900 MHz", 925, 3450, 3799, 880, 21450, 21799),
    fdd("9", "1800 MHz (Japan)", 1844.9, 3800, 4149, 1749.9, 21800, 22149),
    fdd("10", "1700/2100 MHz (extended AWS)", 2110, 4150, 4749, 1710, 22150, 22749),
    fdd("11", "1500 MHz (lower, Japan)", 1475.9, 4750, 4949, 1427.9, 22750, 22949),
    fdd("12", "700 MHz (lower A, B, C)", 729, 5010, 5179, 699, 23010, 23179),
    fdd("13", "700 MHz (upper C)", 746, 5180, 5279, 777, 23180, 23279),
    fdd("14", "700 MHz (upper D, public safety)", 758, 5280, 5379, 788, 23280, 23379),
    fdd("17", "700 MHz (lower B, C)", 734, 5730, 5849, 704, 23730, 23849),
    fdd("18", "800 MHz (lower, Japan)", 860, 5850, 5999, 815, 23850, 23999),
    fdd("19", "800 MHz (upper, Japan)", 875, 6000, 6149, 830, 24000, 24149),
    fdd("20", "800 MHz (digital dividend)", 791, 6150, 6449, 832, 24150, 24449),
    fdd("21", "1500 MHz (upper, Japan)", 1495.9, 6450, 6599, 1447.9, 24450, 24599),
    fdd("22", "3500 MHz", 3510, 6600, 7399, 3410, 24600, 25399),
    fdd("23", "2000 MHz (S band)", 2180, 7500, 7699, 2000, 25500, 25699),
    fdd("24", "1600 MHz (L band)", 1525, 7700, 8039, 1626.5, 25700, 26039),
    fdd("25", "1900 MHz (extended PCS)", 1930, 8040, 8689, 1850, 26040, 26689),
    fdd("26", "850 MHz (extended)", 859, 8690, 9039, 814, 26690, 27039),
    fdd("27", "800 MHz (SMR)", 852, 9040, 9209, 807, 27040, 27209),
    fdd("28", "700 MHz (APT)", 758, 9210, 9659, 703, 27210, 27659),
    sdl("29", "700 MHz (lower D, E)", 717, 9660, 9769),
    fdd("30", "2300 MHz (WCS)", 2350, 9770, 9869, 2305, 27660, 27759),
    fdd("31", "450 MHz", 462.5, 9870, 9919, 452.5, 27760, 27809),
    sdl("32", "1500 MHz (L band)", 1452, 9920, 10359),
    tdd("33", "1900 MHz", 1900, 36000, 36199),
    tdd("34", "2000 MHz", 2010, 36200, 36349),
    tdd("35", "1900 MHz (PCS uplink)", 1850, 36350, 36949),
    tdd("36", "1900 MHz (PCS downlink)", 1930, 36950, 37549),
    tdd("37", "1900 MHz (PCS centre gap)", 1910, 37550, 37749),
    tdd("38", "2600 MHz (centre gap)", 2570, 37750, 38249),
    tdd("39", "1900 MHz (China)", 1880, 38250, 38649),
    tdd("40", "2300 MHz", 2300, 38650, 39649),
    tdd("41", "2500 MHz", 2496, 39650, 41589),
    tdd("42", "3500 MHz", 3400, 41590, 43589),
    tdd("43", "3700 MHz", 3600, 43590, 45589),
    tdd("44", "700 MHz (APT)", 703, 45590, 46589),
    tdd("45", "1500 MHz (L band, China)", 1447, 46590, 46789),
    tdd("46", "5200 MHz (licensed-assisted access)", 5150, 46790, 54539),
    tdd("47", "5900 MHz (vehicles)", 5855, 54540, 55239),
    tdd("48", "3600 MHz (CBRS)", 3550, 55240, 56739),
    tdd("49", "3600 MHz (licensed-assisted access)", 3550, 56740, 58239),
    tdd("50", "1500 MHz (L band)", 1432, 58240, 59089),
    tdd("51", "1500 MHz (L band, extended)", 1427, 59090, 59139),
    tdd("52", "3300 MHz", 3300, 59140, 60139),
    tdd("53", "2500 MHz (S band)", 2483.5, 60140, 60254),
    fdd("65", "2100 MHz (extended)", 2110, 65536, 66435, 1920, 131072, 131971),
    fdd("66", "1700/2100 MHz (AWS-3)", 2110, 66436, 67335, 1710, 131972, 132671),
    sdl("67", "700 MHz (centre gap)", 738, 67336, 67535),
    fdd("68", "700 MHz (Middle East)", 753, 67536, 67835, 698, 132672, 132971),
    sdl("69", "2600 MHz (centre gap)", 2570, 67836, 68335),
    fdd("70", "1700/2000 MHz (AWS-4)", 1995, 68336, 68585, 1695, 132972, 133121),
    fdd("71", "600 MHz", 617, 68586, 68935, 663, 133122, 133471),
    fdd("72", "450 MHz (PMR)", 461, 68936, 68985, 451, 133472, 133521),
    fdd("73", "450 MHz (Asia)", 460, 68986, 69035, 450, 133522, 133571),
    fdd("74", "1500 MHz (lower L band)", 1475, 69036, 69465, 1427, 133572, 134001),
    sdl("75", "1500 MHz (L band)", 1432, 69466, 70315),
    sdl("76", "1500 MHz (L band, extended)", 1427, 70316, 70365),
    fdd("85", "700 MHz (lower A, B, C, extended)", 728, 70366, 70545, 698, 134002, 134181),
    fdd("87", "410 MHz", 420, 70546, 70595, 410, 134182, 134231),
    fdd("88", "410 MHz (PMR)", 422, 70596, 70645, 412, 134232, 134281),
    sdl("252", "5200 MHz (unlicensed)", 5150, 255144, 256143),
    sdl("255", "5800 MHz (unlicensed)", 5725, 260894, 262143),
};

} // namespace

std::span<const ChannelRange> eutraRanges()
{
    return Ranges;
}

} // namespace spectrel
