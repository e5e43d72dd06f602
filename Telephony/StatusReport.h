#pragma once

#include "Platform/Clock.h"
#include "Platform/RunLoop.h"
#include "Telephony/LogSource.h"
#include "Telephony/TelephonyService.h"

#include <chrono>
#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace spectrel {

/// What the service is doing, in lines for people: the source, and of each channel its client, what it asked for, its
/// messages a second, what was sent, what waits for it and what it lost. Rates count from the report before.
class StatusReport {
public:
    StatusReport(const Clock& clock, const TelephonyService& service, const LogSource& source);

    /// "the lte drive; 2 clients, 68 messages/s", and a line for each channel.
    std::vector<std::string> lines();
    /// The first of them alone; rates of `lines` are not touched.
    std::string headline() const;
    /// Whether a report would show something new: anything was sent, or the channels are others.
    bool hasNews() const;

private:
    struct Counted {
        std::uint64_t sent = 0;
        std::chrono::nanoseconds time {0}; // steady
    };
    double rate(const ChannelStatus& channel) const;

    const Clock& _clock;
    const TelephonyService& _service;
    const LogSource& _source;
    std::map<std::string, Counted> _before; // by the channel's name
};

/// Reports on standard error every so often, when there is news; ends with its destruction.
class RegularReport {
public:
    RegularReport(RunLoop& runLoop, StatusReport& report, std::chrono::milliseconds interval);

private:
    std::unique_ptr<Timer> _timer;
};

/// Prints the whole report on standard error.
void printStatus(StatusReport& report);

} // namespace spectrel
