#pragma once

#include <string>
#include <string_view>

namespace spectrel {

/// Appends a text as a JSON string, quotes included. The one place that escapes for JSON.
void appendJsonText(std::string_view text, std::string& out);

} // namespace spectrel
