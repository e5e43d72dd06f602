#pragma once

#include "Records/Recording.h"
#include "Values/Bytes.h"

#include <memory>

namespace spectrel {

/// Whether a file of these bytes is taken for a DLF: it starts with the version report, or with a short item that fits.
bool looksLikeDLF(ByteView bytes);

/// Whether the bytes are, or start with, the version report that opens a DLF.
bool startsWithVersionReport(ByteView bytes);
/// When the file was written, by its version report; 1970 when it does not reach so far.
Moment timeOfVersionReport(ByteView report);

/// Reads the messages that the items of a DLF stand for.
std::unique_ptr<RecordingReader> openDLF(Bytes bytes);

} // namespace spectrel
