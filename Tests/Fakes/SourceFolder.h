#pragma once

#include <string>

namespace spectrel {

/// The full path of a file or folder of the source tree, such as "Resources".
std::string sourcePath(const std::string& relativePath);

} // namespace spectrel
