#include "Analysis/Report/HTMLText.h"

#include "Values/UTF8.h"

#include <array>
#include <cmath>
#include <cstdint>
#include <cstdio>

namespace spectrel {

namespace {

std::string_view escapeOf(char32_t character)
{
    switch (character) {
    case '&':
        return "&amp;";
    case '<':
        return "&lt;";
    case '>':
        return "&gt;";
    case '"':
        return "&quot;";
    default:
        return {};
    }
}

bool isControl(char32_t character)
{
    return character < 0x20 || (character >= 0x7F && character < 0xA0);
}

struct Calendar {
    int year;
    unsigned month;
    unsigned day;
    int hour;
    int minute;
    int second;
};

Calendar calendarOf(Moment time)
{
    const auto day = std::chrono::floor<std::chrono::days>(time);
    const std::chrono::year_month_day date(day);
    const auto seconds = static_cast<int>(std::chrono::floor<std::chrono::seconds>(time - day).count());
    return {int(date.year()), unsigned(date.month()), unsigned(date.day()), seconds / 3600, seconds / 60 % 60,
        seconds % 60};
}

template <typename... Arguments> std::string printed(const char* format, Arguments... arguments)
{
    std::array<char, 64> text {};
    const int length = std::snprintf(text.data(), text.size(), format, arguments...);
    return std::string(text.data(), length > 0 ? static_cast<std::size_t>(length) : 0);
}

} // namespace

std::string escaped(std::string_view text)
{
    std::string out;
    while (!text.empty()) {
        const auto next = decodeUTF8(text);
        const char32_t character = next && !isControl(next->character) ? next->character : ReplacementCharacter;
        text.remove_prefix(next ? next->bytes : 1);
        if (const std::string_view escape = escapeOf(character); !escape.empty())
            out += escape;
        else
            appendUTF8(out, character);
    }
    return out;
}

/// Without printf, which writes the locale's decimal point.
std::string decimalText(double number, int decimals)
{
    const double scale = std::pow(10, decimals);
    const auto scaled = static_cast<std::int64_t>(std::llround(std::abs(number) * scale));
    std::string digits = std::to_string(scaled);
    if (decimals > 0) {
        const auto places = static_cast<std::size_t>(decimals);
        if (digits.size() <= places)
            digits.insert(0, places + 1 - digits.size(), '0');
        digits.insert(digits.size() - places, 1, '.');
    }
    return number < 0 && scaled != 0 ? "-" + digits : digits;
}

std::string levelText(const std::optional<double>& level)
{
    return level ? decimalText(*level, 1) : "–";
}

std::string clockText(Moment time)
{
    const Calendar at = calendarOf(time);
    return printed("%02d:%02d:%02d", at.hour, at.minute, at.second);
}

std::string minuteText(Moment time)
{
    const Calendar at = calendarOf(time);
    return printed("%02d:%02d", at.hour, at.minute);
}

std::string dateText(Moment time)
{
    const Calendar at = calendarOf(time);
    return printed("%04d-%02u-%02u ", at.year, at.month, at.day) + clockText(time);
}

std::string machineTimeText(Moment time)
{
    const Calendar at = calendarOf(time);
    return printed("%04d-%02u-%02uT", at.year, at.month, at.day) + clockText(time) + "Z";
}

std::string durationText(double seconds)
{
    const auto whole = static_cast<long long>(std::llround(std::max(0.0, seconds)));
    return whole >= 3600 ? printed("%lld:%02lld:%02lld", whole / 3600, whole / 60 % 60, whole % 60)
                         : printed("%lld:%02lld", whole / 60, whole % 60);
}

} // namespace spectrel
