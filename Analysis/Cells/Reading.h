#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace spectrel {

/// How a leaf's text is turned into a number.
enum class Reading : std::uint8_t {
    Number, // the number that the text begins with, whatever unit follows: "-91.75 dBm", "10 MHz", "136 × 64chips"
    Signed16, // a 16-bit number whose bits are shown as if it had no sign
    RXLEV, // a GSM level of 0 to 63, whatever unit follows; in dBm (3GPP TS 45.008, 8.1.4)
    RXLEVWithoutUnit, // the same where no unit follows, dBm where one does
    FilteredRSCP, // a 256th of the reported level (3GPP TS 25.123, 9.1.1.1.3: RSCP_LEV 0 to 91); in dBm
    ColourCodes, // a BSIC as "NCC-BCC"
    BracketedNumber, // the number in the brackets at the end: "1.8 to 2.0GHz PCS band [1]"
    Pilot, // a ratio in dB, which may have "(ref pilot)" before it; the floor of -50 dB stands for no measurement
};

/// None for what is no such number: "-", "N/A", an empty or blank text, "nan", a number out of the form's range.
std::optional<double> readNumber(Reading reading, std::string_view text);

/// Whether the text says nothing: empty, blank, "-", "N/A".
bool saysNothing(std::string_view text);

inline constexpr std::string_view ReferencePilotMark = "(ref pilot) ";

} // namespace spectrel
