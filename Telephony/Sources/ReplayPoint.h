#pragma once

#include "Platform/Clock.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string_view>

namespace spectrel {

/// A place on a recording's time line, as a user writes it.
class ReplayPoint {
public:
    /// So long after the recording's first message.
    static ReplayPoint after(std::chrono::microseconds offset);
    /// A wall-clock time: "2024-03-05 14:07:31", "2024-03-05T14:07", "14:07:31.5", each with "Z", "+0100" or "+01:00"
    /// behind it, or else in the device's time zone. Without a day it is the first such time from the recording's first
    /// message on. None for anything else.
    static std::optional<ReplayPoint> wallClock(std::string_view text);

    /// `first`: the recording's first message.
    Moment in(Moment first, const Clock& clock) const;
    bool isOffset() const
    {
        return _kind == Kind::Offset;
    }
    std::chrono::microseconds offset() const
    {
        return _time;
    }

private:
    enum class Kind : std::uint8_t { Offset, TimeOfDay, DayAndTime };

    Moment universal(std::chrono::sys_days day, const Clock& clock) const;

    Kind _kind = Kind::Offset;
    std::chrono::microseconds _time {0}; // the offset, or the time since midnight
    std::chrono::sys_days _day {};
    std::optional<std::chrono::minutes> _zone; // east of UTC
};

} // namespace spectrel
