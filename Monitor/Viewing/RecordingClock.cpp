#include "Monitor/Viewing/RecordingClock.h"

namespace spectrel {

ZoneState RecordingClock::zoneAt(Moment) const
{
    return {};
}

std::string RecordingClock::formatted(Moment moment, std::string_view) const
{
    return defaultDateForm(moment);
}

} // namespace spectrel
