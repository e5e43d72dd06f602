#pragma once

#include "Values/Moment.h"

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>

namespace spectrel {

struct ZoneState {
    std::int32_t secondsEastOfUTC = 0; // daylight-saving time included
    bool isDaylightSaving = false;
};

/// The device's clock and its time zone.
class Clock {
public:
    virtual ~Clock() = default;
    virtual Moment now() const = 0;
    /// For intervals: the time since some moment that stays the same. Unlike `now` nobody sets it.
    virtual std::chrono::nanoseconds steady() const;
    virtual ZoneState zoneAt(Moment moment) const = 0;
    /// The moment in the device's time zone by a pattern such as "'Updated' yyyy-MM-dd 'at' HH:mm:ss": quoted text is
    /// literal, yyyy MM dd HH mm ss are the calendar fields.
    virtual std::string formatted(Moment moment, std::string_view pattern) const = 0;

    /// The system's time, in UTC: for whoever has no clock of the device.
    static const Clock& utc();
};

} // namespace spectrel
