#pragma once

#include "Records/Recording.h"
#include "Values/Value.h"

#include <memory>
#include <string>

namespace spectrel {

/// Reads the messages that a snapshot's history entries hold. Null, with `reason`, when the list is no snapshot.
std::unique_ptr<RecordingReader> openSnapshot(const Value& list, std::string& reason);

} // namespace spectrel
