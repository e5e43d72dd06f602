#include "CommandLine/Program/LiveServices.h"

#include "Platform/Places.h"

#include <unistd.h>

namespace spectrel {

LiveServices::LiveServices(const Context& context)
    : _context(context)
    , _ports(Places::portDirectory(), context.log)
    , _telephony(_ports)
{
}

std::string LiveServices::portPrefixFor(const std::string& job)
{
    return "org.spectrel." + job + "." + std::to_string(::getpid());
}

} // namespace spectrel
