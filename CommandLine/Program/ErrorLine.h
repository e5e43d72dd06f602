#pragma once

#include <string_view>

namespace spectrel {

/// "spectrel: LINE" on standard error.
void report(std::string_view line);

} // namespace spectrel
