#pragma once

#include "Monitor/Viewing/ViewedFile.h"
#include "Platform/Context.h"
#include "Platform/Qt/QtRunLoop.h"
#include "UI/ScreenToolkit.h"

#include <string>

namespace spectrel {

/// The application object over a file, in a front end that has started: launch, run until the run loop ends,
/// termination. No session is opened, nothing is saved. Lines on standard error name the file by `path`. Returns the
/// exit status, which says whether the file is whole.
int runViewingApplication(
    ViewedFile& file, const std::string& path, QtRunLoop& runLoop, ScreenToolkit& toolkit, const Context& context);

} // namespace spectrel
