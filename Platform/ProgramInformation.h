#pragma once

#include <optional>
#include <string>

namespace spectrel {

/// The program's version string, as its bundle information tells it; none when it has none.
std::optional<std::string> programVersion();

} // namespace spectrel
