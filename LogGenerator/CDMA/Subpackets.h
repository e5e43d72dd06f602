#pragma once

#include "Platform/SystemLog.h"
#include "Records/RecordView.h"

#include <cstddef>
#include <cstdint>
#include <optional>

namespace spectrel {

/// Bytes before the first subpacket of the 1x records that hold some: record header, version, count, two more.
constexpr std::size_t SubpacketsStart = 17;

/// Where the first subpacket with the id starts; its first bytes are the id, one byte not interpreted, and the 16-bit
/// size, these four included. None when there is none or a size before it (its own included) leads too far, which is
/// logged.
std::optional<std::size_t> findSubpacket(SystemLog& log, RecordView record, std::uint8_t id);

} // namespace spectrel
