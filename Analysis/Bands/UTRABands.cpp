#include "Analysis/Bands/ChannelRange.h"

#include <array>

namespace spectrel {

namespace {

constexpr Hertz Raster = hertz(0.2); // TS 25.101, 5.4.2; TS 25.102, 5.4.2
constexpr Hertz BlockSpacing = hertz(5); // between most additional channels

struct Ends {
    double low; // MHz: the lowest and highest carrier
    double high;
    double offset; // F_Offset of the numbers: N = 5 × (F − F_Offset)
};

constexpr ChannelRange::Side side(const Ends& ends, Hertz spacing)
{
    const auto number = static_cast<std::uint32_t>((hertz(ends.low) - hertz(ends.offset)) / Raster);
    const auto count = static_cast<std::uint32_t>((hertz(ends.high) - hertz(ends.low)) / spacing + 1);
    return {number, count, hertz(ends.low)};
}

constexpr ChannelRange fdd(std::string_view band, std::string_view name, const Ends& uplink, const Ends& downlink)
{
    return {band, name, Duplex::FDD, side(downlink, Raster), side(uplink, Raster), Raster};
}

constexpr ChannelRange sdl(std::string_view band, std::string_view name, const Ends& downlink)
{
    return {band, name, Duplex::SDL, side(downlink, Raster), {}, Raster};
}

/// Additional channels 5 MHz apart.
constexpr ChannelRange blocks(std::string_view band, std::string_view name, const Ends& uplink, const Ends& downlink)
{
    return {band, name, Duplex::FDD, side(downlink, BlockSpacing), side(uplink, BlockSpacing), BlockSpacing,
        BlockSpacing / Raster};
}

/// An additional channel apart from the others: its uplink and downlink frequency, and the band's offsets.
constexpr ChannelRange single(
    std::string_view band, std::string_view name, double uplink, double uplinkOffset, double downlink, double offset)
{
    return fdd(band, name, {uplink, uplink, uplinkOffset}, {downlink, downlink, offset});
}

constexpr std::string_view PCS = "1900 MHz (PCS)";
constexpr std::string_view AWS = "1700/2100 MHz (AWS-1)";
constexpr std::string_view Cellular = "850 MHz";
constexpr std::string_view Japan850 = "850 MHz (Japan)";
constexpr std::string_view IMTExtension = "2600 MHz";
constexpr std::string_view ExtendedAWS = "1700/2100 MHz (extended AWS)";
constexpr std::string_view Lower700 = "700 MHz (lower A, B, C)";
constexpr std::string_view Upper700C = "700 MHz (upper C)";
constexpr std::string_view Upper700D = "700 MHz (upper D, public safety)";
constexpr std::string_view Upper800 = "800 MHz (upper, Japan)";
constexpr std::string_view ExtendedPCS = "1900 MHz (extended PCS)";
constexpr std::string_view Extended850 = "850 MHz (extended)";

/// TS 25.101 Release 16, 5.4.4: tables 5.1 (general channels) and 5.1A (additional channels). Bands are written in
/// Roman numerals there.
constexpr std::array FDDRanges {
    fdd("1", "2100 MHz", {1922.4, 1977.6, 0}, {2112.4, 2167.6, 0}),
    fdd("2", PCS, {1852.4, 1907.6, 0}, {1932.4, 1987.6, 0}),
    blocks("2", PCS, {1852.5, 1907.5, 1850.1}, {1932.5, 1987.5, 1850.1}),
    fdd("3", "1800 MHz", {1712.4, 1782.6, 1525}, {1807.4, 1877.6, 1575}),
    fdd("4", AWS, {1712.4, 1752.6, 1450}, {2112.4, 2152.6, 1805}),
    blocks("4", AWS, {1712.5, 1752.5, 1380.1}, {2112.5, 2152.5, 1735.1}),
    fdd("5", Cellular, {826.4, 846.6, 0}, {871.4, 891.6, 0}),
    single("5", Cellular, 826.5, 670.1, 871.5, 670.1),
    single("5", Cellular, 827.5, 670.1, 872.5, 670.1),
    single("5", Cellular, 831.5, 670.1, 876.5, 670.1),
    blocks("5", Cellular, {832.5, 842.5, 670.1}, {877.5, 887.5, 670.1}),
    fdd("6", Japan850, {832.4, 837.6, 0}, {877.4, 882.6, 0}),
    blocks("6", Japan850, {832.5, 837.5, 670.1}, {877.5, 882.5, 670.1}),
    fdd("7", IMTExtension, {2502.4, 2567.6, 2100}, {2622.4, 2687.6, 2175}),
    blocks("7", IMTExtension, {2502.5, 2567.5, 2030.1}, {2622.5, 2687.5, 2105.1}),
    fdd("8", "900 MHz", {882.4, 912.6, 340}, {927.4, 957.6, 340}),
    fdd("9", "1800 MHz (Japan)", {1752.4, 1782.4, 0}, {1847.4, 1877.4, 0}),
    fdd("10", ExtendedAWS, {1712.4, 1767.6, 1135}, {2112.4, 2167.6, 1490}),
    blocks("10", ExtendedAWS, {1712.5, 1767.5, 1075.1}, {2112.5, 2167.5, 1430.1}),
    fdd("11", "1500 MHz (lower, Japan)", {1430.4, 1445.4, 733}, {1478.4, 1493.4, 736}),
    fdd("12", Lower700, {701.4, 713.6, -22}, {731.4, 743.6, -37}),
    blocks("12", Lower700, {701.5, 706.5, -39.9}, {731.5, 736.5, -54.9}),
    blocks("12", Lower700, {707.5, 712.5, -39.9}, {737.5, 742.5, -54.9}),
    single("12", Lower700, 713.5, -39.9, 743.5, -54.9),
    fdd("13", Upper700C, {779.4, 784.6, 21}, {748.4, 753.6, -55}),
    blocks("13", Upper700C, {779.5, 784.5, 11.1}, {748.5, 753.5, -64.9}),
    fdd("14", Upper700D, {790.4, 795.6, 12}, {760.4, 765.6, -63}),
    blocks("14", Upper700D, {790.5, 795.5, 2.1}, {760.5, 765.5, -72.9}),
    fdd("19", Upper800, {832.4, 842.6, 770}, {877.4, 887.6, 735}),
    blocks("19", Upper800, {832.5, 842.5, 755.1}, {877.5, 887.5, 720.1}),
    fdd("20", "800 MHz (digital dividend)", {834.4, 859.6, -23}, {793.4, 818.6, -109}),
    fdd("21", "1500 MHz (upper, Japan)", {1450.4, 1460.4, 1358}, {1498.4, 1508.4, 1326}),
    fdd("22", "3500 MHz", {3412.4, 3487.6, 2525}, {3512.4, 3587.6, 2580}),
    fdd("25", ExtendedPCS, {1852.4, 1912.6, 875}, {1932.4, 1992.6, 910}),
    blocks("25", ExtendedPCS, {1852.5, 1912.5, 639.1}, {1932.5, 1992.5, 674.1}),
    fdd("26", Extended850, {816.4, 846.6, -291}, {861.4, 891.6, -291}),
    blocks("26", Extended850, {816.5, 826.5, -325.9}, {861.5, 871.5, -325.9}),
    single("26", Extended850, 827.5, -325.9, 872.5, -325.9),
    single("26", Extended850, 831.5, -325.9, 876.5, -325.9),
    blocks("26", Extended850, {832.5, 842.5, -325.9}, {877.5, 887.5, -325.9}),
    sdl("32", "1500 MHz (L band)", {1454.4, 1493.6, 131}),
};

/// The carriers that fit between a band's edges, N = 5 × F: the narrowest ones, of 1.28 Mcps, keep 0.8 MHz from each.
constexpr ChannelRange tdd(std::string_view band, std::string_view name, double low, double high)
{
    const ChannelRange::Side both = side({low + 0.8, high - 0.8, 0}, Raster);
    return {band, name, Duplex::TDD, both, both, Raster};
}

/// TS 25.102, 5.2 (frequency bands) and 5.4.3 (channel numbers), in the order of the E-UTRA bands whose numbers they
/// have. Bands share carriers: a number alone does not tell which of them it is.
constexpr std::array TDDRanges {
    tdd("33", "1900 MHz", 1900, 1920),
    tdd("34", "2000 MHz", 2010, 2025),
    tdd("35", "1900 MHz (PCS uplink)", 1850, 1910),
    tdd("36", "1900 MHz (PCS downlink)", 1930, 1990),
    tdd("37", "1900 MHz (PCS centre gap)", 1910, 1930),
    tdd("38", "2600 MHz (centre gap)", 2570, 2620),
    tdd("39", "1900 MHz (China)", 1880, 1920),
    tdd("40", "2300 MHz", 2300, 2400),
};

} // namespace

std::span<const ChannelRange> utraFDDRanges()
{
    return FDDRanges;
}

std::span<const ChannelRange> utraTDDRanges()
{
    return TDDRanges;
}

} // namespace spectrel
