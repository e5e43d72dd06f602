#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <vector>

namespace spectrel {

using Bytes = std::vector<std::uint8_t>;
using ByteView = std::span<const std::uint8_t>;

/// Bytes that several values share; nobody changes them once they are shared.
using DataRef = std::shared_ptr<const Bytes>;

/// A log message, and so a port message, has 1 byte to 256 KiB.
inline constexpr std::size_t LargestMessage = 256 * 1024;

} // namespace spectrel
