#include "Monitor/Viewing/RecordingClock.h"

namespace spectrel {

RecordingClock::RecordingClock()
{
    Clock::install(this);
}

RecordingClock::~RecordingClock()
{
    Clock::install(nullptr);
}

ZoneState RecordingClock::zoneAt(Moment) const
{
    return {};
}

std::string RecordingClock::formatted(Moment moment, std::string_view) const
{
    return defaultDateForm(moment);
}

} // namespace spectrel
