#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// Whose channels: UTRAN's are those of FDD and of TDD.
enum class ChannelTechnology : std::uint8_t { LTE, UTRAN, GSM, CDMA };

/// From "lte", "utran", "gsm", "cdma".
std::optional<ChannelTechnology> channelTechnologyNamed(std::string_view name);

enum class ChannelFormat : std::uint8_t { Text, Json };

/// From "text", "json".
std::optional<ChannelFormat> channelFormatNamed(std::string_view name);

/// What `spectrel channel` was asked for: a number or a frequency.
struct ChannelOptions {
    ChannelTechnology technology = ChannelTechnology::LTE;
    std::optional<std::uint32_t> number;
    std::optional<double> mhz;
    std::optional<std::string> band; // only this one
    ChannelFormat format = ChannelFormat::Text;
};

/// Prints the bands of a channel to standard output. Answers the program's exit status: failed when no band has it.
int channel(const ChannelOptions& options);

} // namespace spectrel
