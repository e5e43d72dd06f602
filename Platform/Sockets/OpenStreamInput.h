#pragma once

#include "Platform/StreamInput.h"
#include "Values/Result.h"

#include <memory>
#include <string>

namespace spectrel {

/// The input at an address: "-" (standard input), the path of a FIFO or a device, "unix:PATH" (listens on a socket of
/// that path, for this user), or "tcp:HOST:PORT" (listens; "tcp:PORT" on this machine alone, port 0 on any free one).
/// A failure names the address.
Result<std::unique_ptr<StreamInput>> openStreamInput(const std::string& address);

} // namespace spectrel
