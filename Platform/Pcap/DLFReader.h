#pragma once

#include "Platform/Bytes.h"
#include "Platform/Recording.h"

#include <memory>

namespace spectrel {

/// Whether a file of these bytes is taken for a DLF: it starts with the version report, or with a short item that fits.
bool looksLikeDLF(ByteView bytes);

/// Reads the messages that the items of a DLF stand for.
std::unique_ptr<RecordingReader> openDLF(Bytes bytes);

} // namespace spectrel
