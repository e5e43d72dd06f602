#pragma once

#include <string_view>

namespace spectrel {

/// "spectrel: LINE" on standard error; dropped, and counted, where nobody takes it.
void report(std::string_view line);

} // namespace spectrel
