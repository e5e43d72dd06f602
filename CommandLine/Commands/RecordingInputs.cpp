#include "CommandLine/Commands/RecordingInputs.h"

#include <algorithm>
#include <utility>

namespace spectrel {

RecordingInputs openRecordings(const std::vector<std::string>& paths)
{
    RecordingInputs opened;
    for (const std::string& path : paths) {
        const bool isStandardInput = path == "-";
        RecordingInput input {path, isStandardInput ? "standard input" : path, nullptr, {}, true};
        auto reader = openRecording(isStandardInput ? "/dev/stdin" : path);
        if (!reader) {
            opened.failures.push_back(reader.failure().of(input.name).text);
            continue;
        }
        input.reader = std::move(*reader);
        input.isEmpty = !input.reader->next(input.first);
        opened.inputs.push_back(std::move(input));
    }
    std::stable_sort(
        opened.inputs.begin(), opened.inputs.end(), [](const RecordingInput& left, const RecordingInput& right) {
            return left.isEmpty != right.isEmpty ? right.isEmpty : !left.isEmpty && left.first.time < right.first.time;
        });
    return opened;
}

} // namespace spectrel
