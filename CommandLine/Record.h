#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

namespace spectrel {

/// What `spectrel record` was asked for.
struct RecordOptions {
    std::string file;
    std::optional<std::uint64_t> count; // messages
    std::optional<std::chrono::milliseconds> duration;
};

/// Records a live session into a capture file, as delivered, until interrupted or until what was asked for is recorded.
/// A baseband that changes its technology goes on in a further file. Answers the program's exit status.
int record(const RecordOptions& options);

} // namespace spectrel
