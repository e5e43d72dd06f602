#pragma once

#include "CommandLine/Commands/Arguments.h"

#include <optional>
#include <string>
#include <vector>

namespace spectrel {

enum class Screens : std::uint8_t { Graphical, Terminal, None };

/// The screens that the choice and the surroundings give: a display before a terminal, None where there is neither.
/// Absent, reported on standard error, when the terminal was asked for and is not there.
std::optional<Screens> findScreens(ScreenChoice choice);

/// Becomes the program with the graphical screens, which stands beside this one where it is installed; comes back, with
/// an exit status, only when that fails. `options` come before the common ones (--resources, --log).
int runGraphical(const Arguments& arguments, std::vector<std::string> options);

} // namespace spectrel
