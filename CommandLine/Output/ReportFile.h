#pragma once

#include "Values/Result.h"

#include <string>
#include <string_view>

namespace spectrel {

/// Writes a report's page into a file, whole or not at all; "-" is standard output. Only a report is overwritten: a
/// file with other contents, such as a recording that was named by mistake, is refused. Failures name the file.
Outcome writeReportFile(const std::string& path, std::string_view page);

} // namespace spectrel
