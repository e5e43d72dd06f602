#pragma once

#include "Values/Moment.h"

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// A text as the content of an element or an attribute's value: markup is escaped, and what is no character is
/// replaced.
std::string escaped(std::string_view text);

/// With so many decimals, in the C locale, "-0" without its sign.
std::string decimalText(double number, int decimals);
/// A level or "–".
std::string levelText(const std::optional<double>& level);

/// "14:07:31", UTC.
std::string clockText(Moment time);
/// "14:07", UTC.
std::string minuteText(Moment time);
/// "2024-03-05 14:07:31", UTC.
std::string dateText(Moment time);
/// "2024-03-05T14:07:31Z", as machines read it.
std::string machineTimeText(Moment time);
/// "1:02:03" or "2:03".
std::string durationText(double seconds);

} // namespace spectrel
