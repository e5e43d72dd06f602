#include "Telephony/Modem/FrequencyBands.h"

#include <algorithm>
#include <array>

namespace spectrel {

namespace {

struct Band {
    std::uint32_t first; // downlink E-ARFCN
    std::uint32_t last;
    std::uint32_t number;
};

constexpr bool operator<(const Band& left, const Band& right)
{
    return left.last < right.first;
}

constexpr std::array<Band, 66> Bands {{
    {0, 599, 1},
    {600, 1199, 2},
    {1200, 1949, 3},
    {1950, 2399, 4},
    {2400, 2649, 5},
    {2650, 2749, 6},
    {2750, 3449, 7},
    {3450, 3799, 8},
    {3800, 4149, 9},
    {4150, 4749, 10},
    {4750, 4949, 11},
    {5010, 5179, 12},
    {5180, 5279, 13},
    {5280, 5379, 14},
    {5730, 5849, 17},
    {5850, 5999, 18},
    {6000, 6149, 19},
    {6150, 6449, 20},
    {6450, 6599, 21},
    {6600, 7399, 22},
    {7500, 7699, 23},
    {7700, 8039, 24},
    {8040, 8689, 25},
    {8690, 9039, 26},
    {9040, 9209, 27},
    {9210, 9659, 28},
    {9660, 9769, 29},
    {9770, 9869, 30},
    {9870, 9919, 31},
    {9920, 10359, 32},
    {36000, 36199, 33},
    {36200, 36349, 34},
    {36350, 36949, 35},
    {36950, 37549, 36},
    {37550, 37749, 37},
    {37750, 38249, 38},
    {38250, 38649, 39},
    {38650, 39649, 40},
    {39650, 41589, 41},
    {41590, 43589, 42},
    {43590, 45589, 43},
    {45590, 46589, 44},
    {46590, 46789, 45},
    {46790, 54539, 46},
    {54540, 55239, 47},
    {55240, 56739, 48},
    {56740, 58239, 49},
    {58240, 59089, 50},
    {59090, 59139, 51},
    {59140, 60139, 52},
    {60140, 60254, 53},
    {65536, 66435, 65},
    {66436, 67335, 66},
    {67336, 67535, 67},
    {67536, 67835, 68},
    {67836, 68335, 69},
    {68336, 68585, 70},
    {68586, 68935, 71},
    {68936, 68985, 72},
    {68986, 69035, 73},
    {69036, 69465, 74},
    {69466, 70315, 75},
    {70316, 70365, 76},
    {70366, 70545, 85},
    {70546, 70595, 87},
    {70596, 70645, 88},
}};
static_assert(std::is_sorted(Bands.begin(), Bands.end()));

} // namespace

std::optional<std::uint32_t> lteBand(std::uint32_t channel)
{
    const auto band = std::lower_bound(
        Bands.begin(), Bands.end(), channel, [](const Band& held, std::uint32_t wanted) { return held.last < wanted; });
    if (band == Bands.end() || channel < band->first)
        return std::nullopt;
    return band->number;
}

} // namespace spectrel
