#include "CommandLine/Options/OptionTypes.h"

#include <array>
#include <charconv>
#include <cmath>
#include <span>
#include <utility>

namespace spectrel {

namespace {

using Unit = std::pair<std::string_view, double>; // what stands behind a number, and what it is worth

/// The number of a text such as "1.5k", times the worth of its unit.
std::optional<double> parseWithUnit(std::string_view text, std::span<const Unit> units)
{
    const std::size_t digits = std::min(text.find_first_not_of("0123456789."), text.size());
    double number = 0;
    const auto result = std::from_chars(text.data(), text.data() + digits, number);
    if (digits == 0 || result.ec != std::errc() || result.ptr != text.data() + digits)
        return std::nullopt;
    for (const auto& [unit, worth] : units) {
        if (text.substr(digits) == unit)
            return number * worth;
    }
    return std::nullopt;
}

std::optional<std::uint64_t> parseCount(std::string_view text)
{
    return parseWholeNumber(text, 1, std::numeric_limits<std::uint64_t>::max());
}

std::optional<std::string> parseName(std::string_view text)
{
    return text.empty() ? std::nullopt : std::optional<std::string>(text);
}

} // namespace

const OptionForm<Technology> TechnologyForm {
    "ifx|gsm|cdma|lte|utran", technologyNamed, "is not one of ifx, gsm, cdma, lte, utran"};
const OptionForm<std::chrono::milliseconds> DurationForm {
    "TIME", parseDuration, "is no time such as 30s, 5m, 2h or 500ms"};
const OptionForm<std::uint64_t> SizeForm {"SIZE", parseSize, "is no size such as 500k, 100M or 2G; the least is 1k"};
const OptionForm<std::uint64_t> CountForm {"N", parseCount, "is no whole number from 1 up"};
const OptionForm<std::string> FileForm {"FILE", parseName, "names no file"};
const OptionForm<std::string> FolderForm {"DIR", parseName, "names no folder"};

std::optional<std::uint64_t> parseWholeNumber(std::string_view text, std::uint64_t least, std::uint64_t largest)
{
    std::uint64_t number = 0;
    const char* const end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number);
    if (result.ec != std::errc() || result.ptr != end || number < least || number > largest)
        return std::nullopt;
    return number;
}

std::optional<double> parseNumber(std::string_view text, double least, double largest)
{
    double number = 0;
    const char* const end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number);
    // Written so that a not-a-number is outside.
    if (result.ec != std::errc() || result.ptr != end || !(number >= least && number <= largest))
        return std::nullopt;
    return number;
}

std::optional<std::uint64_t> parseSize(std::string_view text)
{
    static constexpr std::array<Unit, 4> Units {{{"", 1.0}, {"k", 1e3}, {"M", 1e6}, {"G", 1e9}}};
    const auto bytes = parseWithUnit(text, Units);
    return bytes && *bytes >= 1000 && *bytes < 1e15 ? std::optional<std::uint64_t>(std::llround(*bytes)) : std::nullopt;
}

std::optional<std::chrono::milliseconds> parseOffset(std::string_view text)
{
    static constexpr std::array<Unit, 5> Units {{{"ms", 1.0}, {"s", 1e3}, {"m", 60e3}, {"h", 3600e3}, {"", 1e3}}};
    const auto milliseconds = parseWithUnit(text, Units);
    if (!milliseconds || *milliseconds >= 1e12)
        return std::nullopt;
    return std::chrono::milliseconds(std::llround(*milliseconds));
}

std::optional<std::chrono::milliseconds> parseDuration(std::string_view text)
{
    const auto duration = parseOffset(text);
    return duration && duration->count() > 0 ? duration : std::nullopt;
}

} // namespace spectrel
