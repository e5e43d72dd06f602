#pragma once

#include <string>

namespace spectrel {

/// "spectrel-telephonyd: LINE" on standard error; dropped, and counted, where nobody takes it.
void printServiceLine(const std::string& line);

} // namespace spectrel
