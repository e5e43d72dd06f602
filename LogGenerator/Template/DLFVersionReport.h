#pragma once

#include "Platform/Clock.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace spectrel {

/// Size of the version-report record that begins a DLF, and its log code.
constexpr std::size_t DLFVersionReportSize = 161;
constexpr std::uint16_t DLFVersionReportCode = 0x1FFD;

enum class DLFResult : int {
    Written = 0,
    BufferTooSmall = 3,
};

/// Seconds since 1970 (bits 0 to 31), the zone's minutes east of UTC (32 to 47) and the daylight flag (48 to 55).
std::uint64_t makeDLFTimeWord(Moment moment, ZoneState zone);

/// Writes the version-report record: little-endian, texts cut to their fixed fields and NUL-terminated, every other
/// byte zero. `bytesWritten` is 161, or 0 when the buffer is smaller than that.
DLFResult DLFAddVersionReport(std::span<std::uint8_t> buffer, std::uint32_t& bytesWritten, std::uint16_t firstVersion,
    std::uint16_t secondVersion, std::string_view versionText, std::string_view executableName,
    std::string_view buildDate, std::uint64_t timeWord);

} // namespace spectrel
