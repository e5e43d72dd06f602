#pragma once

#include <string>
#include <string_view>

namespace spectrel {

/// Appends a field of RFC 4180: quoted where it holds a separator, a quote or a line end.
void appendCsvField(std::string_view field, std::string& out);

} // namespace spectrel
