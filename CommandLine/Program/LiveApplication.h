#pragma once

#include "CommandLine/Program/LiveServices.h"
#include "UI/ScreenToolkit.h"

#include <functional>

namespace spectrel {

/// The application object over the live session, in a front end that has started: launch, run until the run loop ends,
/// termination. A record that ends the process leaves a snapshot; `restoreScreen`, which may be empty, is called
/// before.
void runLiveApplication(LiveServices& live, ScreenToolkit& toolkit, const std::function<void()>& restoreScreen);

} // namespace spectrel
