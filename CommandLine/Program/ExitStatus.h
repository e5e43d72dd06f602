#pragma once

namespace spectrel {

/// Exit statuses of every program.
namespace ExitStatus {
inline constexpr int Done = 0;
inline constexpr int Failed = 1;
inline constexpr int WrongUsage = 2;
} // namespace ExitStatus

} // namespace spectrel
