#pragma once

#include "Platform/Clock.h"

#include <string>
#include <string_view>

namespace spectrel {

/// The system's clock, in the device's time zone or in a fixed one.
class QtClock final : public Clock {
public:
    /// `zone`: an IANA name such as "Europe/Berlin" or "UTC"; empty follows the device's zone, also when that changes.
    /// An unknown name means UTC.
    explicit QtClock(std::string zone = {});

    Moment now() const override;
    ZoneState zoneAt(Moment moment) const override;
    std::string formatted(Moment moment, std::string_view pattern) const override;

private:
    std::string _zone;
};

} // namespace spectrel
