#include "Analysis/NetworkCode.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <optional>

namespace spectrel {

namespace {

/// Countries whose network codes have three digits (Annex to ITU-T E.212).
constexpr std::array<std::uint32_t, 22> LongCodeCountries {
    302, 310, 311, 312, 313, 314, 316, 334, 338, 342, 344, 346, 348, 350, 352, 354, 356, 358, 360, 365, 366, 376};

bool isDigits(std::string_view text)
{
    return !text.empty() && std::ranges::all_of(text, [](char one) { return one >= '0' && one <= '9'; });
}

std::optional<std::uint32_t> numberOf(std::string_view text)
{
    if (!isDigits(text) || text.size() > 3)
        return std::nullopt;
    std::uint32_t number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

std::string padded(std::uint32_t number, std::size_t width)
{
    std::string text = std::to_string(number);
    return std::string(width > text.size() ? width - text.size() : 0, '0') + text;
}

} // namespace

std::string NetworkCode::read(std::string_view country, std::string_view network)
{
    const bool hasShortCode = network.size() == 3 && network.back() == ' ';
    const std::string_view code = hasShortCode ? network.substr(0, 2) : network;
    const auto countryNumber = numberOf(country);
    const auto networkNumber = numberOf(code);
    if (!countryNumber || *countryNumber == 0 || !networkNumber)
        return {};
    if (country.size() == 3 && network.size() == 3) {
        _digits = std::string(country) + "-" + std::string(code);
        return _digits;
    }
    if (!_digits.empty() && numberOf(std::string_view(_digits).substr(0, 3)) == countryNumber
        && numberOf(std::string_view(_digits).substr(4)) == networkNumber)
        return _digits;
    const bool isLong = std::ranges::binary_search(LongCodeCountries, *countryNumber);
    return padded(*countryNumber, 3) + "-" + padded(*networkNumber, isLong ? 3 : 2);
}

bool isNetworkCode(std::string_view text)
{
    return (text.size() == 6 || text.size() == 7) && text[3] == '-' && isDigits(text.substr(0, 3))
        && isDigits(text.substr(4));
}

} // namespace spectrel
