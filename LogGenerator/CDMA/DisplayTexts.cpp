#include "LogGenerator/CDMA/DisplayTexts.h"

#include <array>
#include <cmath>
#include <span>

namespace spectrel {

namespace {

constexpr std::array<std::string_view, 6> EVDODeviceStates {
    "Inactive [0]", "Acquisition [1]", "Sync [2]", "Idle [3]", "Access [4]", "Connected [5]"};

constexpr std::array<std::string_view, 5> EVDOSessionStates {
    "Closed [0]", "AMP setup [1]", "AT-initiated neg [2]", "Initiated neg [3]", "Open [4]"};

constexpr std::array<std::string_view, 13> BandClasses {
    "800 MHz cellular band [0]",
    "1.8 to 2.0GHz PCS band [1]",
    "872 to 960MHz TACS band [2]",
    "832 to 925MHz JTACS band [3]",
    "1.75 to 1.87GHz Korean PCS band [4]",
    "450MHz band [5]",
    "2GHz band [6]",
    "700MHz band [7]",
    "1800 MHz band [8]",
    "900 MHzband [9]", // the missing blank is part of the text
    "Secondary 800 MHz band [10]",
    "400 MHz European PAMR band [11]",
    "800 MHz European PAMR band [12]",
};

constexpr std::array<std::string_view, 12> OneXDeviceStates {
    "Inactive [0]",
    "Deep sleep in start state [1]",
    "Initial state for CDMA operation [2]",
    "Acquisition [3]",
    "Sync [4]",
    "Slew [5]",
    "Paging [6]",
    "Slotted mode sleep state [7]",
    "Traffic [8]",
    "UnSlew [9]",
    "Operation in PCG state [10]",
    "Powerup state [11]",
};

constexpr std::array<std::string_view, 13> RoamingIndicators {
    "OFF [0]",
    "ON [1]",
    "Flashing [2]",
    "Out of Neighborhood [3]",
    "Out of Building [4]",
    "Preferred system [5]",
    "Available system [6]",
    "Alliance partner [7]",
    "Premium partner [8]",
    "Full service functionality [9]",
    "Partial service functionality [10]",
    "Banner ON [11]",
    "Banner OFF [12]",
};

/// The text of a value, or the value between two pieces of text.
std::string_view textOf(std::uint32_t value, std::span<const std::string_view> texts, std::string_view before,
    std::string_view behind, TextBuffer& buffer)
{
    if (value < texts.size())
        return texts[value];
    return buffer.text(before).decimal(static_cast<std::int32_t>(value)).text(behind).view();
}

} // namespace

std::string_view evdoDeviceState(std::uint32_t value, TextBuffer& buffer)
{
    return textOf(value, EVDODeviceStates, "[Reserved ", "]", buffer);
}

std::string_view evdoSessionState(std::uint32_t value, TextBuffer& buffer)
{
    return textOf(value, EVDOSessionStates, "[Reserved ", "]", buffer);
}

std::string_view bandClass(std::uint32_t value, TextBuffer& buffer)
{
    return textOf(value, BandClasses, "[Bad Value ", "]", buffer);
}

std::string_view oneXDeviceState(std::uint32_t value, TextBuffer& buffer)
{
    return textOf(value, OneXDeviceStates, "[Bad Value ", "]", buffer);
}

std::string_view roamingIndicator(std::uint32_t value, TextBuffer& buffer)
{
    return textOf(value, RoamingIndicators, "ERI - ", "", buffer);
}

std::string_view wholePower(std::uint32_t value, TextBuffer& buffer)
{
    const auto power = static_cast<std::int32_t>(value);
    return buffer.text(power < 0 ? "" : "+").decimal(power).text(" dBm").view();
}

TextBuffer& appendSigned(TextBuffer& buffer, double number)
{
    if (std::isnan(number))
        return buffer.text("nan");
    if (std::isinf(number))
        return buffer.text(number < 0 ? "-inf" : "+inf");
    return buffer.text(std::signbit(number) ? "" : "+").fixed2(number);
}

std::string_view decibels(double ratio, TextBuffer& buffer)
{
    return appendSigned(buffer, 10 * std::log10(ratio)).text(" dB").view();
}

} // namespace spectrel
