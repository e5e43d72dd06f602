#pragma once

#include "Records/Recording.h"
#include "Records/RecordingFile.h"
#include "Values/Bytes.h"
#include "Values/Result.h"

#include <memory>

namespace spectrel {

/// Whether a file that starts so is a capture: classic pcap in either byte order with micro- or nanoseconds, or pcapng.
bool startsCapture(ByteView firstBytes);

/// Reads a capture packet by packet; memory does not grow with its length. Fails when its head is broken.
Result<std::unique_ptr<RecordingReader>> openCapture(RecordingFile file);

} // namespace spectrel
