#pragma once

#include "CommandLine/Commands/Decode.h"
#include "Platform/Context.h"

namespace spectrel {

/// Decodes each recording as a session of its own, each in a process of its own, for what guards the display belongs to
/// a process. What they print comes in the order of the files, each file's complaints behind its output; until it is
/// their turn it waits in temporary files, of a few files at most. Answers the program's exit status, in the processes
/// of the single files, too, which return from here as well.
int decodeSeparately(const DecodeOptions& options, const Context& context);

} // namespace spectrel
