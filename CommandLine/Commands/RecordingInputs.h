#pragma once

#include "Records/Recording.h"

#include <memory>
#include <string>
#include <vector>

namespace spectrel {

/// A recording that is open, with its first message.
struct RecordingInput {
    std::string path;
    std::string name; // as messages give it: "standard input" for "-"
    std::unique_ptr<RecordingReader> reader;
    RecordedMessage first; // valid until the reader's next one
    bool isEmpty = true; // there is no first message
};

/// What has been opened, in the order of the first messages (empty recordings last, equals as they were given), and one
/// line for each that could not be.
struct RecordingInputs {
    std::vector<RecordingInput> inputs;
    std::vector<std::string> failures;
};

/// Opens the recordings; "-" is standard input.
RecordingInputs openRecordings(const std::vector<std::string>& paths);

} // namespace spectrel
