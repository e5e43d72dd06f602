#include "Values/PropertyList/PropertyListScalars.h"

#include <charconv>
#include <chrono>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <system_error>

namespace spectrel {

namespace {

using namespace std::chrono;

constexpr sys_seconds Origin = sys_days(year(2001) / 1 / 1);

std::string_view trimmed(std::string_view text)
{
    constexpr std::string_view Space = " \t\n\r";
    const std::size_t first = text.find_first_not_of(Space);
    if (first == std::string_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(Space) - first + 1);
}

/// Takes the sign off the front.
bool takeSign(std::string_view& text)
{
    const bool negative = text.starts_with('-');
    if (negative || text.starts_with('+'))
        text.remove_prefix(1);
    return negative;
}

template <typename Number, typename... Form> bool readAll(std::string_view text, Number& number, Form... form)
{
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number, form...);
    return result.ec == std::errc() && result.ptr == end;
}

/// The decimal digits at the place; -1 when one of them is none.
int digitsAt(std::string_view text, std::size_t place, std::size_t count)
{
    unsigned number = 0;
    const std::string_view digits = text.substr(place, count);
    if (!readAll(digits, number))
        return -1;
    return static_cast<int>(number);
}

} // namespace

std::optional<Integer> parseIntegerText(std::string_view text)
{
    constexpr std::uint64_t LargestNegative = 1ull << 63;
    text = trimmed(text);
    const bool negative = takeSign(text);
    const bool hexadecimal = text.starts_with("0x") || text.starts_with("0X");
    if (hexadecimal)
        text.remove_prefix(2);
    std::uint64_t magnitude = 0;
    if (!readAll(text, magnitude, hexadecimal ? 16 : 10) || (negative && magnitude > LargestNegative))
        return std::nullopt;
    return negative ? Integer::fromSigned(static_cast<std::int64_t>(0 - magnitude)) : Integer::fromUnsigned(magnitude);
}

std::optional<double> parseRealText(std::string_view text)
{
    text = trimmed(text);
    const bool negative = takeSign(text);
    double number = 0;
    if (text.starts_with('-') || text.ends_with(')') || !readAll(text, number)) // "nan(...)" is no number here
        return std::nullopt;
    return negative ? -number : number;
}

std::optional<Date> parseDateText(std::string_view text)
{
    text = trimmed(text);
    if (text.size() != 20 || text[4] != '-' || text[7] != '-' || text[10] != 'T' || text[13] != ':' || text[16] != ':'
        || text[19] != 'Z')
        return std::nullopt;
    const int fields[] = {digitsAt(text, 0, 4), digitsAt(text, 5, 2), digitsAt(text, 8, 2), digitsAt(text, 11, 2),
        digitsAt(text, 14, 2), digitsAt(text, 17, 2)};
    for (const int field : fields) {
        if (field < 0)
            return std::nullopt;
    }
    const year_month_day day =
        year(fields[0]) / month(static_cast<unsigned>(fields[1])) / std::chrono::day(static_cast<unsigned>(fields[2]));
    if (!day.ok() || fields[3] > 23 || fields[4] > 59 || fields[5] > 59)
        return std::nullopt;
    const sys_seconds moment = sys_days(day) + hours(fields[3]) + minutes(fields[4]) + seconds(fields[5]);
    return Date {static_cast<double>((moment - Origin).count())};
}

std::string integerText(Integer number)
{
    return number.isNegative() ? std::to_string(static_cast<std::int64_t>(number.bits()))
                               : std::to_string(number.bits());
}

std::string realText(double number)
{
    if (std::isnan(number))
        return "nan";
    char digits[32]; // the shortest form of a double has at most 24 characters
    const auto result = std::to_chars(digits, digits + sizeof digits, number);
    return {digits, result.ptr};
}

std::optional<std::string> dateText(Date date)
{
    constexpr auto First = static_cast<double>((sys_seconds(sys_days(year(0) / 1 / 1)) - Origin).count());
    constexpr auto Behind = static_cast<double>((sys_seconds(sys_days(year(10000) / 1 / 1)) - Origin).count());
    if (!(date.secondsSince2001 >= First && date.secondsSince2001 < Behind))
        return std::nullopt;
    const sys_seconds moment = Origin + seconds(static_cast<std::int64_t>(std::floor(date.secondsSince2001)));
    const auto midnight = floor<days>(moment);
    const year_month_day day(midnight);
    const hh_mm_ss time(moment - midnight);
    char text[64];
    std::snprintf(text, sizeof text, "%04d-%02u-%02uT%02d:%02d:%02dZ", static_cast<int>(day.year()),
        static_cast<unsigned>(day.month()), static_cast<unsigned>(day.day()), static_cast<int>(time.hours().count()),
        static_cast<int>(time.minutes().count()), static_cast<int>(time.seconds().count()));
    return text;
}

} // namespace spectrel
