#pragma once

#include "Platform/StreamInput.h"

#include <memory>
#include <string>

namespace spectrel {

/// The input at an address: "-" (standard input), the path of a FIFO or a device, "unix:PATH" (listens on a socket of
/// that path, for this user), or "tcp:HOST:PORT" (listens; "tcp:PORT" on this machine alone, port 0 on any free one).
/// Null, with `reason` naming the address, when it cannot be had.
std::unique_ptr<StreamInput> openStreamInput(const std::string& address, std::string& reason);

} // namespace spectrel
