#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// The folders that a program of this system stands on.
namespace Surroundings {

/// The display templates' folder: the one named, or the installed one. None, reported on standard error, when there is
/// no such folder.
std::optional<std::string> templates(const std::optional<std::string>& named);

/// Makes the message ports' folder, if need be. False, reported on standard error, when it cannot be had, or when the
/// local port of a session with this prefix does not fit: no session could ever be opened.
bool preparePorts(std::string_view portPrefix);

} // namespace Surroundings

} // namespace spectrel
