#pragma once

#include <string_view>

namespace spectrel {

/// Writes a line, which comes without its end, on standard error, and never waits for whoever reads it: a line that a
/// full pipe does not take is dropped. Once lines are taken again, how many were dropped is written first.
/// `program` leads in that line, as it does those of the caller: "spectrel".
void writeErrorLine(std::string_view program, std::string_view line);

} // namespace spectrel
