#include "CommandLine/Output/TimeForm.h"

#include <chrono>
#include <cstdio>

namespace spectrel {

namespace {

struct SplitMoment {
    std::chrono::sys_seconds seconds;
    long long microseconds;
};

SplitMoment split(Moment time)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(time);
    return {seconds, static_cast<long long>((time - seconds).count())};
}

std::string rfc3339(Moment time)
{
    const auto [seconds, microseconds] = split(time);
    const auto day = std::chrono::floor<std::chrono::days>(seconds);
    const std::chrono::year_month_day date(day);
    const std::chrono::hh_mm_ss clock(seconds - day);
    char text[80];
    std::snprintf(text, sizeof text, "%04d-%02u-%02uT%02d:%02d:%02d.%06lldZ", static_cast<int>(date.year()),
        static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()), static_cast<int>(clock.hours().count()),
        static_cast<int>(clock.minutes().count()), static_cast<int>(clock.seconds().count()), microseconds);
    return text;
}

} // namespace

std::optional<TimeForm> timeFormNamed(std::string_view name)
{
    if (name == "seconds")
        return TimeForm::Seconds;
    if (name == "rfc3339")
        return TimeForm::RFC3339;
    return std::nullopt;
}

std::string timeText(Moment time, TimeForm form)
{
    if (form == TimeForm::RFC3339)
        return rfc3339(time);
    return secondsForm(time);
}

std::string jsonTimeText(Moment time, TimeForm form)
{
    const std::string text = timeText(time, form);
    return form == TimeForm::RFC3339 ? '"' + text + '"' : text;
}

std::string timeOfDay(Moment time)
{
    return rfc3339(time).substr(11, 8);
}

} // namespace spectrel
