#pragma once

#include "Values/Bytes.h"

#include <cstdint>

namespace spectrel {

/// The code by which a message is routed (extra stream: code + 0xFF0000), its wrapper aside; false when it is too short
/// or of an unknown type.
bool routedCode(ByteView message, std::uint32_t& code);

} // namespace spectrel
