#pragma once

#include "CommandLine/Commands/EventOutput.h"
#include "CommandLine/Output/OutputWriter.h"
#include "Platform/Context.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace spectrel {

/// What `spectrel watch` was asked for.
struct WatchOptions {
    OutputOptions output;
    std::optional<std::uint64_t> count; // refreshes
    std::optional<std::chrono::milliseconds> duration;
    EventOptions events;
};

/// Prints a live session, once at each refresh, until interrupted or until what was asked for has been printed. Answers
/// the program's exit status.
int watch(const WatchOptions& options, const Context& context);

} // namespace spectrel
