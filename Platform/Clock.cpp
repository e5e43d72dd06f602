#include "Platform/Clock.h"

namespace spectrel {

namespace {

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

const UTCClock utcClock;

} // namespace

std::chrono::nanoseconds Clock::steady() const
{
    return std::chrono::steady_clock::now().time_since_epoch();
}

const Clock& Clock::utc()
{
    return utcClock;
}

} // namespace spectrel
