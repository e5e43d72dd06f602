#include "Analysis/Cells/Reading.h"

#include <charconv>
#include <cmath>

namespace spectrel {

namespace {

constexpr std::string_view Blanks = " \t";

std::string_view withoutLeadingBlanks(std::string_view text)
{
    const std::size_t start = text.find_first_not_of(Blanks);
    return start == std::string_view::npos ? std::string_view() : text.substr(start);
}

struct LeadingNumber {
    double value;
    std::string_view rest;
};

std::optional<LeadingNumber> leadingNumber(std::string_view text)
{
    text = withoutLeadingBlanks(text);
    if (text.starts_with('+'))
        text.remove_prefix(1);
    double value = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value, std::chars_format::fixed);
    if (error != std::errc() || !std::isfinite(value))
        return std::nullopt;
    const std::string_view rest = text.substr(static_cast<std::size_t>(end - text.data()));
    if (!rest.empty() && Blanks.find(rest.front()) == std::string_view::npos)
        return std::nullopt; // "00F110", "12-3": no number but a text that begins with digits
    return LeadingNumber {value, withoutLeadingBlanks(rest)};
}

std::optional<double> wholeWithin(double value, double min, double max)
{
    if (value != std::floor(value) || value < min || value > max)
        return std::nullopt;
    return value;
}

std::optional<double> signed16(double value)
{
    const auto whole = wholeWithin(value, -32768, 65535);
    return whole && *whole > 32767 ? *whole - 65536 : whole;
}

std::optional<double> rxlev(double value)
{
    const auto level = wholeWithin(value, 0, 63);
    return level ? std::optional(*level - 110) : std::nullopt;
}

/// Six decimals are shown, so that the level comes out a little off.
std::optional<double> filteredRSCP(double value)
{
    constexpr double Inexactness = 256 * 1e-6;
    const double scaled = value * 256;
    const double nearest = std::round(scaled);
    if (std::abs(scaled - nearest) > Inexactness)
        return std::nullopt;
    const auto level = wholeWithin(nearest, 0, 91);
    return level ? std::optional(*level - 116) : std::nullopt;
}

std::optional<double> colourCodes(std::string_view text)
{
    text = withoutLeadingBlanks(text);
    const auto isColour = [](char digit) { return digit >= '0' && digit <= '7'; };
    if (text.size() != 3 || text[1] != '-' || !isColour(text[0]) || !isColour(text[2]))
        return std::nullopt;
    return (text[0] - '0') * 8 + (text[2] - '0');
}

std::optional<double> bracketedNumber(std::string_view text)
{
    const std::size_t open = text.rfind('[');
    if (open == std::string_view::npos || !text.ends_with(']'))
        return std::nullopt;
    const auto number = leadingNumber(text.substr(open + 1, text.size() - open - 2));
    return number && number->rest.empty() ? std::optional(number->value) : std::nullopt;
}

std::optional<double> pilotRatio(std::string_view text)
{
    constexpr double Floor = -50;
    if (text.starts_with(ReferencePilotMark))
        text.remove_prefix(ReferencePilotMark.size());
    const auto number = leadingNumber(text);
    return number && number->value > Floor ? std::optional(number->value) : std::nullopt;
}

std::optional<double> readPlain(Reading reading, const LeadingNumber& number)
{
    switch (reading) {
    case Reading::Signed16:
        return signed16(number.value);
    case Reading::RXLEV:
        return rxlev(number.value);
    case Reading::RXLEVWithoutUnit:
        return number.rest.empty() ? rxlev(number.value) : number.value;
    case Reading::FilteredRSCP:
        return filteredRSCP(number.value);
    default:
        return number.value;
    }
}

} // namespace

std::optional<double> readNumber(Reading reading, std::string_view text)
{
    if (reading == Reading::ColourCodes)
        return colourCodes(text);
    if (reading == Reading::BracketedNumber)
        return bracketedNumber(text);
    if (reading == Reading::Pilot)
        return pilotRatio(text);
    const auto number = leadingNumber(text);
    return number ? readPlain(reading, *number) : std::nullopt;
}

bool saysNothing(std::string_view text)
{
    text = withoutLeadingBlanks(text);
    const std::size_t last = text.find_last_not_of(Blanks);
    text = text.substr(0, last == std::string_view::npos ? 0 : last + 1);
    return text.empty() || text == "-" || text == "N/A";
}

} // namespace spectrel
