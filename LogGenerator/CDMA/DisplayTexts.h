#pragma once

#include "Values/TextBuffer.h"

#include <cstdint>
#include <string_view>

/// Display texts of field values. Those that take a field's value are formatters of field tables.
namespace spectrel {

/// 0 to 5; any other value is "[Reserved %d]".
std::string_view evdoDeviceState(std::uint32_t value, TextBuffer& buffer);
/// 0 to 4; any other value is "[Reserved %d]".
std::string_view evdoSessionState(std::uint32_t value, TextBuffer& buffer);
/// 0 to 12 (3GPP2 C.S0057); any other value is "[Bad Value %d]".
std::string_view bandClass(std::uint32_t value, TextBuffer& buffer);
/// 0 to 11; any other value is "[Bad Value %d]".
std::string_view oneXDeviceState(std::uint32_t value, TextBuffer& buffer);
/// Enhanced roaming indicator, 0 to 12 (3GPP2 C.R1001, table 8.1-1); any other value is "ERI - %d".
std::string_view roamingIndicator(std::uint32_t value, TextBuffer& buffer);

/// "%+d dBm".
std::string_view wholePower(std::uint32_t value, TextBuffer& buffer);

/// "%+.2f"; a not-a-number is "nan", without a sign.
TextBuffer& appendSigned(TextBuffer& buffer, double number);
/// 10 * lg(ratio) as "%+.2f dB".
std::string_view decibels(double ratio, TextBuffer& buffer);

} // namespace spectrel
