#include "Platform/Clock.h"

#include <cstdio>

namespace spectrel {

namespace {

/// What the generators read before a program installs its clock: the system's time, in UTC.
class UTCClock final : public Clock {
public:
    Moment now() const override
    {
        return std::chrono::time_point_cast<std::chrono::microseconds>(std::chrono::system_clock::now());
    }
    ZoneState zoneAt(Moment) const override
    {
        return {};
    }
    std::string formatted(Moment moment, std::string_view) const override
    {
        return defaultDateForm(moment);
    }
};

UTCClock utcClock;
Clock* installedClock = &utcClock;

} // namespace

void Clock::install(Clock* clock)
{
    installedClock = clock ? clock : &utcClock;
}

Clock& Clock::installed()
{
    return *installedClock;
}

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

bool parseDefaultDateForm(std::string_view text, Moment& moment)
{
    int year = 0;
    unsigned month = 0;
    unsigned day = 0;
    int hour = 0;
    int minute = 0;
    int second = 0;
    char sign = 0;
    int zone = 0;
    int length = 0;
    const std::string copy(text);
    if (std::sscanf(copy.c_str(), "%4d-%2u-%2u %2d:%2d:%2d %c%4d%n", &year, &month, &day, &hour, &minute, &second,
            &sign, &zone, &length)
            != 8
        || static_cast<std::size_t>(length) != text.size() || (sign != '+' && sign != '-'))
        return false;
    const std::chrono::year_month_day date{ std::chrono::year(year), std::chrono::month(month), std::chrono::day(day) };
    if (!date.ok())
        return false;
    const auto east = std::chrono::minutes((zone / 100 * 60 + zone % 100) * (sign == '-' ? -1 : 1));
    moment = std::chrono::sys_days(date) + std::chrono::hours(hour) + std::chrono::minutes(minute)
        + std::chrono::seconds(second) - east;
    return true;
}

} // namespace spectrel
