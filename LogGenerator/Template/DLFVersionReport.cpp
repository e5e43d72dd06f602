#include "LogGenerator/Template/DLFVersionReport.h"

#include <algorithm>

namespace spectrel {

namespace {

/// Where the record's fields stand; everything between them is zero.
namespace Offset {
constexpr std::size_t Length = 0;
constexpr std::size_t Code = 2;
constexpr std::size_t FirstVersion = 12;
constexpr std::size_t SecondVersion = 14;
constexpr std::size_t VersionText = 16;
constexpr std::size_t ExecutableName = 23;
constexpr std::size_t BuildDate = 63;
constexpr std::size_t Time = 81; // seconds, zone and daylight flag, packed as in the time word
} // namespace Offset

// Widths of the text fields, the terminating NUL included.
constexpr std::size_t VersionTextWidth = 7;
constexpr std::size_t ExecutableNameWidth = 16;
constexpr std::size_t BuildDateWidth = 18;
constexpr std::size_t TimeWidth = 7;

void putNumber(std::span<std::uint8_t> record, std::size_t offset, std::uint64_t number, std::size_t width)
{
    for (std::size_t byte = 0; byte < width; ++byte)
        record[offset + byte] = static_cast<std::uint8_t>(number >> 8 * byte);
}

void putText(std::span<std::uint8_t> record, std::size_t offset, std::string_view text, std::size_t width)
{
    const std::string_view fitting = text.substr(0, std::min(text.find('\0'), width - 1));
    std::ranges::copy(fitting, record.begin() + static_cast<std::ptrdiff_t>(offset));
}

} // namespace

std::uint64_t makeDLFTimeWord(Moment moment, ZoneState zone)
{
    const auto seconds = std::chrono::floor<std::chrono::seconds>(moment).time_since_epoch().count();
    const auto minutes = static_cast<std::int16_t>(zone.secondsEastOfUTC / 60); // rounds toward zero
    return static_cast<std::uint32_t>(seconds) | static_cast<std::uint64_t>(static_cast<std::uint16_t>(minutes)) << 32
        | static_cast<std::uint64_t>(zone.isDaylightSaving ? 1 : 0) << 48;
}

DLFResult DLFAddVersionReport(std::span<std::uint8_t> buffer, std::uint32_t& bytesWritten, std::uint16_t firstVersion,
    std::uint16_t secondVersion, std::string_view versionText, std::string_view executableName,
    std::string_view buildDate, std::uint64_t timeWord)
{
    bytesWritten = 0;
    if (buffer.size() < DLFVersionReportSize)
        return DLFResult::BufferTooSmall;
    const auto record = buffer.first(DLFVersionReportSize);
    std::ranges::fill(record, std::uint8_t(0));
    putNumber(record, Offset::Length, DLFVersionReportSize, 2);
    putNumber(record, Offset::Code, DLFVersionReportCode, 2);
    putNumber(record, Offset::FirstVersion, firstVersion, 2);
    putNumber(record, Offset::SecondVersion, secondVersion, 2);
    putText(record, Offset::VersionText, versionText, VersionTextWidth);
    putText(record, Offset::ExecutableName, executableName, ExecutableNameWidth);
    putText(record, Offset::BuildDate, buildDate, BuildDateWidth);
    putNumber(record, Offset::Time, timeWord, TimeWidth);
    bytesWritten = static_cast<std::uint32_t>(DLFVersionReportSize);
    return DLFResult::Written;
}

} // namespace spectrel
