#pragma once

#include "Records/Recording.h"
#include "Records/RecordingFile.h"
#include "Values/Bytes.h"

#include <memory>
#include <string>

namespace spectrel {

/// Whether a file that starts so is a capture: classic pcap in either byte order with micro- or nanoseconds, or pcapng.
bool startsCapture(ByteView firstBytes);

/// Reads a capture packet by packet; memory does not grow with its length. Null, with `reason`, when its head is
/// broken.
std::unique_ptr<RecordingReader> openCapture(RecordingFile file, std::string& reason);

} // namespace spectrel
