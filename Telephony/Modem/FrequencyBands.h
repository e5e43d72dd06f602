#pragma once

#include <cstdint>
#include <optional>

namespace spectrel {

/// The E-UTRA operating band of a downlink channel number; none when no band holds it.
///
/// Source: 3GPP TS 36.101, table 5.7.3-1. Channel numbers of the bands do not overlap.
std::optional<std::uint32_t> lteBand(std::uint32_t channel);

} // namespace spectrel
