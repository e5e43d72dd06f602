#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <vector>

namespace spectrel {

using Bytes = std::vector<std::uint8_t>;
using ByteView = std::span<const std::uint8_t>;

/// Bytes that several values share; nobody changes them once they are shared.
using DataRef = std::shared_ptr<const Bytes>;

} // namespace spectrel
