#pragma once

#include <string>

namespace spectrel {

/// "spectrel-telephonyd: LINE" on standard error.
void printServiceLine(const std::string& line);

} // namespace spectrel
