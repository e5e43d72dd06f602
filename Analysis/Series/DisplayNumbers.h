#pragma once

#include <optional>
#include <string_view>

namespace spectrel {

/// The number that a leaf of the display shows, with or without a unit: "-104.5 dBm", "20 MHz", "12". None for any
/// other text, such as "001-01", "007", "1 of 2" or more than 15 digits, which is an identity rather than a number.
std::optional<double> displayNumber(std::string_view text);

} // namespace spectrel
