#pragma once

#include "Platform/Clock.h"

#include <string>
#include <string_view>

namespace spectrel {

/// The clock of the screens that show a file: it stands at the moment shown, in the device's time zone.
class ViewedClock final : public Clock {
public:
    /// `device` gives the time zone and outlives this.
    explicit ViewedClock(const Clock& device)
        : _device(device)
    {
    }
    void set(Moment moment)
    {
        _now = moment;
    }
    Moment now() const override
    {
        return _now;
    }
    ZoneState zoneAt(Moment moment) const override
    {
        return _device.zoneAt(moment);
    }
    std::string formatted(Moment moment, std::string_view pattern) const override
    {
        return _device.formatted(moment, pattern);
    }

private:
    const Clock& _device;
    Moment _now {};
};

} // namespace spectrel
