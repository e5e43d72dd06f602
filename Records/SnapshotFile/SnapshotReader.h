#pragma once

#include "Records/Recording.h"
#include "Values/Result.h"
#include "Values/Value.h"

#include <memory>

namespace spectrel {

/// Reads the messages that a snapshot's history entries hold. Fails when the list is no snapshot.
Result<std::unique_ptr<RecordingReader>> openSnapshot(const Value& list);

} // namespace spectrel
