#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// The names of the ports in a folder that begin and end so, in alphabetical order. One that was left by a dead process
/// may be among them: who connects finds out. Without the folder there are none.
std::vector<std::string> servedPorts(const std::string& directory, std::string_view prefix, std::string_view ending);

} // namespace spectrel
