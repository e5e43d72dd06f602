#pragma once

#include "Platform/Clock.h"
#include "Values/Bytes.h"

#include <cstddef>
#include <cstdint>

namespace spectrel {

constexpr Moment Epoch1980 = std::chrono::sys_days(std::chrono::year(1980) / 1 / 6);

/// What follows the 13-byte header of an encoded record.
inline Bytes payloadOf(const Bytes& record)
{
    return {record.begin() + 13, record.end()};
}

/// `count` bytes of a record.
inline Bytes part(const Bytes& record, std::size_t offset, std::size_t count)
{
    const auto begin = record.begin() + static_cast<std::ptrdiff_t>(offset);
    return {begin, begin + static_cast<std::ptrdiff_t>(count)};
}

/// The code that a record carries.
inline std::uint32_t codeOf(const Bytes& record)
{
    return static_cast<std::uint32_t>(record[3] | record[4] << 8);
}

} // namespace spectrel
