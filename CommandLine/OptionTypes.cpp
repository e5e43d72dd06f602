#include "CommandLine/OptionTypes.h"

#include <array>
#include <charconv>
#include <cmath>

namespace spectrel {

const CLI::Validator IsTechnology(
    [](std::string& name) {
        return technologyNamed(name) ? std::string() : "'" + name + "' is not one of ifx, gsm, cdma, lte, utran";
    },
    "ifx|gsm|cdma|lte|utran");

const CLI::Validator IsDuration(
    [](std::string& text) {
        return parseDuration(text) ? std::string() : "'" + text + "' is no time such as 30s, 5m, 2h or 500ms";
    },
    "TIME");

const CLI::Validator IsSize(
    [](std::string& text) {
        return parseSize(text) ? std::string() : "'" + text + "' is no size such as 500k, 100M or 2G";
    },
    "SIZE");

std::optional<std::uint64_t> parseSize(std::string_view text)
{
    static constexpr std::array<std::pair<std::string_view, double>, 4> Units {
        {{"", 1.0}, {"k", 1e3}, {"M", 1e6}, {"G", 1e9}}};
    constexpr double Smallest = 1000;
    const std::size_t digits = std::min(text.find_first_not_of("0123456789."), text.size());
    double number = 0;
    const auto result = std::from_chars(text.data(), text.data() + digits, number);
    if (digits == 0 || result.ec != std::errc() || result.ptr != text.data() + digits)
        return std::nullopt;
    for (const auto& [unit, bytes] : Units) {
        if (text.substr(digits) == unit && number * bytes >= Smallest && number * bytes < 1e15)
            return static_cast<std::uint64_t>(std::llround(number * bytes));
    }
    return std::nullopt;
}

std::optional<std::chrono::milliseconds> parseDuration(std::string_view text)
{
    static constexpr std::array<std::pair<std::string_view, double>, 5> Units {
        {{"ms", 1.0}, {"s", 1e3}, {"m", 60e3}, {"h", 3600e3}, {"", 1e3}}};
    const std::size_t digits = std::min(text.find_first_not_of("0123456789."), text.size());
    double number = 0;
    const auto result = std::from_chars(text.data(), text.data() + digits, number);
    if (digits == 0 || result.ec != std::errc() || result.ptr != text.data() + digits)
        return std::nullopt;
    for (const auto& [unit, milliseconds] : Units) {
        if (text.substr(digits) == unit && number * milliseconds >= 1 && number * milliseconds < 1e12)
            return std::chrono::milliseconds(std::llround(number * milliseconds));
    }
    return std::nullopt;
}

} // namespace spectrel
