#pragma once

#include "Platform/Recording.h"

#include <CLI/CLI.hpp>
#include <chrono>
#include <optional>
#include <string_view>

namespace spectrel {

/// A time span such as "30s", "5m", "2h", "500ms"; a number alone counts seconds. None for anything else.
std::optional<std::chrono::milliseconds> parseDuration(std::string_view text);

/// What the options of several programs accept.
extern const CLI::Validator IsTechnology;
extern const CLI::Validator IsDuration;

} // namespace spectrel
