#pragma once

#include "CommandLine/Commands/Arguments.h"
#include "Platform/Context.h"

namespace spectrel {

/// Opens the screens that the arguments and the surroundings ask for: the graphical ones (a program of their own beside
/// this one), the terminal ones, or none at all, printing as `watch` does. Answers the program's exit status.
int runApplication(const Arguments& arguments, const Context& context);

} // namespace spectrel
