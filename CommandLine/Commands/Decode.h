#pragma once

#include "CommandLine/Commands/EventOutput.h"
#include "CommandLine/Output/OutputWriter.h"
#include "Platform/Context.h"
#include "Records/Recording.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// What `spectrel decode` was asked for.
struct DecodeOptions {
    std::vector<std::string> files;
    OutputOptions output;
    bool each = false; // with Json: one line for each message
    bool keepGoing = false; // past a message that would end the running application
    std::optional<Technology> technology; // where a file does not say
    std::optional<std::string> snapshotDirectory;
    bool separate = false; // each file a session of its own
    std::optional<std::uint64_t> jobs; // with separate: files at a time; as many as there are processors
    EventOptions events;
};

/// Decodes the recordings one after the other, as one session or each as its own, and prints the display to standard
/// output. Answers the program's exit status.
int decode(const DecodeOptions& options, const Context& context);

} // namespace spectrel
