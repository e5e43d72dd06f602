#include "Telephony/Reports/GSMCell.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

double GSMCell::c1() const
{
    constexpr double RxLevAccessMin = -104; // dBm, RXLEV_ACCESS_MIN
    return rssi - RxLevAccessMin; // the phone reaches the power the cell allows, which leaves nothing to take off
}

std::uint8_t rxLevel(double rssi)
{
    return static_cast<std::uint8_t>(std::clamp(std::lround(rssi + 110), 0L, 63L));
}

} // namespace spectrel
