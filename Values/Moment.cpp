#include "Values/Moment.h"

#include <cstdio>

namespace spectrel {

std::string defaultDateForm(Moment moment)
{
    const auto day = std::chrono::floor<std::chrono::days>(moment);
    const std::chrono::year_month_day date(day);
    const std::chrono::hh_mm_ss time(std::chrono::floor<std::chrono::seconds>(moment - day));
    char text[64];
    std::snprintf(text, sizeof text, "%04d-%02u-%02u %02d:%02d:%02d +0000", static_cast<int>(date.year()),
        static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()), static_cast<int>(time.hours().count()),
        static_cast<int>(time.minutes().count()), static_cast<int>(time.seconds().count()));
    return text;
}

std::string secondsForm(Moment moment)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(moment);
    char text[40];
    std::snprintf(text, sizeof text, "%lld.%06lld", static_cast<long long>(seconds.time_since_epoch().count()),
        static_cast<long long>((moment - seconds).count()));
    return text;
}

bool parseDefaultDateForm(std::string_view text, Moment& moment)
{
    constexpr std::string_view Form = "0000-00-00 00:00:00 +0000"; // 0: a digit
    if (text.size() != Form.size())
        return false;
    for (std::size_t i = 0; i < Form.size(); ++i) {
        const bool isDigit = text[i] >= '0' && text[i] <= '9';
        const bool isSign = Form[i] == '+' && text[i] == '-';
        if (Form[i] == '0' ? !isDigit : text[i] != Form[i] && !isSign)
            return false;
    }
    const auto field = [&](std::size_t place, std::size_t digits) {
        int number = 0;
        for (std::size_t i = place; i < place + digits; ++i)
            number = number * 10 + (text[i] - '0');
        return number;
    };
    const std::chrono::year_month_day date {std::chrono::year(field(0, 4)),
        std::chrono::month(static_cast<unsigned>(field(5, 2))), std::chrono::day(static_cast<unsigned>(field(8, 2)))};
    if (!date.ok() || field(11, 2) > 23 || field(14, 2) > 59 || field(17, 2) > 59 || field(23, 2) > 59)
        return false;
    const auto east = std::chrono::minutes((field(21, 2) * 60 + field(23, 2)) * (text[20] == '-' ? -1 : 1));
    moment = std::chrono::sys_days(date) + std::chrono::hours(field(11, 2)) + std::chrono::minutes(field(14, 2))
        + std::chrono::seconds(field(17, 2)) - east;
    return true;
}

} // namespace spectrel
