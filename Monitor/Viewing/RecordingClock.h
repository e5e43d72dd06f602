#pragma once

#include "Platform/Clock.h"

#include <string>

namespace spectrel {

/// The clock of a recording that is being decoded: it stands where it is set, in UTC.
class RecordingClock final : public Clock {
public:
    void set(Moment moment)
    {
        _now = moment;
    }
    Moment now() const override
    {
        return _now;
    }
    ZoneState zoneAt(Moment moment) const override;
    std::string formatted(Moment moment, std::string_view pattern) const override;

private:
    Moment _now {};
};

} // namespace spectrel
