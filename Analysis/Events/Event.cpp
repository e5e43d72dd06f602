#include "Analysis/Events/Event.h"

#include <array>
#include <cstddef>

namespace spectrel {

namespace {

constexpr std::array<std::string_view, 13> EventKindNames {"cell", "area", "plmn", "connection", "registration",
    "context", "service-lost", "service-back", "session-lost", "session-back", "bookmark", "alarm", "finding"};
constexpr std::array<std::string_view, 5> CauseKindNames {
    "reselection", "handover", "redirection", "service-lost", "unknown"};
constexpr std::array<std::string_view, 5> RuleNames {
    "higher-priority", "equal-priority", "lower-priority", "not-suitable", "unknown"};

} // namespace

std::string_view eventKindName(EventKind kind)
{
    return EventKindNames[static_cast<std::size_t>(kind)];
}

std::string_view causeKindName(CauseKind kind)
{
    return CauseKindNames[static_cast<std::size_t>(kind)];
}

std::string_view causeRuleName(CauseRule rule)
{
    return RuleNames[static_cast<std::size_t>(rule)];
}

} // namespace spectrel
