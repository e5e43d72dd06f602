#pragma once

#include "CommandLine/Graphical/GraphicalArguments.h"
#include "Platform/Context.h"

namespace spectrel {

/// Opens the graphical screens, or brings those of the application that already runs to the front. Needs the graphical
/// application object. Answers the program's exit status.
int runGraphicalApplication(const GraphicalArguments& arguments, const Context& context);

} // namespace spectrel
