#include "Analysis/Series/DisplayNumbers.h"

#include <algorithm>
#include <charconv>
#include <system_error>

namespace spectrel {

namespace {

bool isDigit(char character)
{
    return character >= '0' && character <= '9';
}

} // namespace

std::optional<double> displayNumber(std::string_view text)
{
    std::string_view digits = text;
    if (digits.starts_with('-') || digits.starts_with('+'))
        digits.remove_prefix(1);
    const auto end = std::min(digits.find_first_not_of("0123456789."), digits.size());
    const std::string_view unit = digits.substr(end);
    digits = digits.substr(0, end);
    if (digits.empty() || !isDigit(digits.front()) || !isDigit(digits.back())
        || std::ranges::count_if(digits, isDigit) > 15)
        return std::nullopt;
    if (digits.size() > 1 && digits.front() == '0' && digits[1] != '.')
        return std::nullopt;
    if (!unit.empty() && unit != "%" && (unit.front() != ' ' || std::ranges::any_of(unit, isDigit)))
        return std::nullopt;
    double number = 0;
    const auto read = std::from_chars(digits.data(), digits.data() + digits.size(), number);
    if (read.ec != std::errc() || read.ptr != digits.data() + digits.size())
        return std::nullopt;
    return text.starts_with('-') ? -number : number;
}

} // namespace spectrel
