#pragma once

#include "Values/Moment.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// How moments are printed.
enum class TimeForm : std::uint8_t {
    Seconds, // since 1970, with six decimals: 1733000000.123456
    RFC3339, // in UTC, with six decimals: 2024-03-05T14:07:31.123456Z
};

/// "seconds", "rfc3339".
std::optional<TimeForm> timeFormNamed(std::string_view name);

std::string timeText(Moment time, TimeForm form);
/// As a JSON value: seconds are a number, the other form is a text.
std::string jsonTimeText(Moment time, TimeForm form);
/// The time of day in UTC: "14:07:31".
std::string timeOfDay(Moment time);

} // namespace spectrel
