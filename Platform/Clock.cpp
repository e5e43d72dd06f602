#include "Platform/Clock.h"

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

std::chrono::nanoseconds Clock::steady() const
{
    return std::chrono::steady_clock::now().time_since_epoch();
}

void Clock::install(Clock* clock)
{
    installedClock = clock ? clock : &utcClock;
}

Clock& Clock::installed()
{
    return *installedClock;
}

} // namespace spectrel
