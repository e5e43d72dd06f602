#include "CommandLine/Program/LiveServices.h"

#include "Platform/Places.h"

#include <unistd.h>

namespace spectrel {

LiveServices::LiveServices()
    : _ports(Places::portDirectory())
    , _telephony(_ports)
{
    Clock::install(&_clock);
}

LiveServices::~LiveServices()
{
    Clock::install(nullptr);
}

std::string LiveServices::portPrefixFor(const std::string& job)
{
    return "org.spectrel." + job + "." + std::to_string(::getpid());
}

} // namespace spectrel
