#include "Records/Beside/Gaps.h"

#include "Records/Beside/Beside.h"

#include <algorithm>
#include <cmath>

namespace spectrel {

namespace {
constexpr double MostLost = 9'007'199'254'740'992; // 2^53, from where on not every number is told apart
}

std::string gapsPath(const std::string& recording)
{
    return pathBeside(recording, GapsEnding);
}

Gaps readGaps(const std::string& recording)
{
    Gaps read;
    read.damage = readBeside(gapsPath(recording), [&read](const JsonObject& object) {
        const auto time = timeOf(object);
        const double lost = object.number("lost").value_or(-1);
        if (!time || !(lost >= 0 && lost <= MostLost) || std::floor(lost) != lost)
            return false;
        read.gaps.push_back({*time, static_cast<std::uint64_t>(lost)});
        return true;
    });
    std::ranges::stable_sort(read.gaps, {}, &Gap::time);
    return read;
}

} // namespace spectrel
