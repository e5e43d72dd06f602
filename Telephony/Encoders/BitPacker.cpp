#include "Telephony/Encoders/BitPacker.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

BitPacker& BitPacker::field(unsigned count, std::uint32_t value)
{
    for (unsigned bit = 0; bit < count; ++bit) {
        if (_used == 0)
            _bytes.push_back(0);
        _bytes.back() = static_cast<std::uint8_t>(_bytes.back() | (value >> bit & 1) << _used);
        _used = (_used + 1) % 8;
    }
    return *this;
}

std::uint32_t levelSteps(double level, double min, double stepsPerUnit, unsigned count)
{
    const double max = std::exp2(count) - 1;
    return static_cast<std::uint32_t>(std::clamp(std::round((level - min) * stepsPerUnit), 0.0, max));
}

} // namespace spectrel
