#pragma once

#include "Values/Value.h"

#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// Numbers and dates as the XML form spells them. White space around them is allowed; all else must be as described.

/// Decimal, or hexadecimal after 0x, with an optional sign; -2^63 to 2^64-1.
std::optional<Integer> parseIntegerText(std::string_view text);
/// A decimal number with optional sign, fraction and exponent, within the range of a double; "inf", "infinity", "nan".
std::optional<double> parseRealText(std::string_view text);
/// "2024-03-05T14:07:31Z", a date that the calendar knows.
std::optional<Date> parseDateText(std::string_view text);

std::string integerText(Integer number);
/// The shortest text that reads back as the same number.
std::string realText(double number);
/// To whole seconds, fractions dropped; none outside the years 0 to 9999.
std::optional<std::string> dateText(Date date);

} // namespace spectrel
