#pragma once

#include <chrono>
#include <string>
#include <string_view>

namespace spectrel {

/// A moment, UTC, to the microsecond.
using Moment = std::chrono::sys_time<std::chrono::microseconds>;

/// The platform's default date form, in UTC whatever the device's zone: "2019-12-09 21:26:56 +0000".
std::string defaultDateForm(Moment moment);

/// The moment that such a text says; none when it is not in that form.
bool parseDefaultDateForm(std::string_view text, Moment& moment);

/// Seconds since 1970 with six decimals: "1733000000.123456".
std::string secondsForm(Moment moment);

} // namespace spectrel
