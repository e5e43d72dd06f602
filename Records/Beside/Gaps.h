#pragma once

#include "Values/Moment.h"

#include <cstdint>
#include <string>
#include <vector>

namespace spectrel {

/// Messages that a recording lacks.
struct Gap {
    Moment time {}; // of the first message behind the gap, or when the loss was noticed
    std::uint64_t lost = 0; // messages
};

/// The gaps of a recording NAME.pcap stand in NAME.gaps beside it, JSON Lines: {"time": 1733000000.123456, "lost": 12}.
std::string gapsPath(const std::string& recording);

struct Gaps {
    std::vector<Gap> gaps; // in the order of time
    std::string damage; // which file could not be read, or which line of it; empty where all is well
};
/// The gaps of a recording; none where there is no such file. Lines that are no gaps are left out.
Gaps readGaps(const std::string& recording);

} // namespace spectrel
