#pragma once

#include "Platform/Recording.h"

#include <CLI/CLI.hpp>
#include <chrono>
#include <cstdint>
#include <optional>
#include <string_view>

namespace spectrel {

/// A time span such as "30s", "5m", "2h", "500ms"; a number alone counts seconds. None for anything else.
std::optional<std::chrono::milliseconds> parseDuration(std::string_view text);

/// A number of bytes such as "500k", "100M", "2G" (powers of 1000); a number alone counts bytes. At least one kilobyte;
/// none for anything else.
std::optional<std::uint64_t> parseSize(std::string_view text);

/// What the options of several programs accept.
extern const CLI::Validator IsTechnology;
extern const CLI::Validator IsDuration;
extern const CLI::Validator IsSize;

} // namespace spectrel
