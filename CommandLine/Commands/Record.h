#pragma once

#include "CommandLine/Commands/RecordingFiles.h"
#include "Platform/Context.h"

#include <chrono>
#include <cstdint>
#include <optional>

namespace spectrel {

/// What `spectrel record` was asked for.
struct RecordOptions {
    RecordingFilesOptions files;
    std::optional<std::uint64_t> count; // messages
    std::optional<std::chrono::milliseconds> duration;
};

/// Records a live session into capture files, as delivered, until interrupted or until what was asked for is recorded.
/// Messages reach the file at most half a second after they came. Answers the program's exit status.
int record(const RecordOptions& options, const Context& context);

} // namespace spectrel
