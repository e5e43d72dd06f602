#pragma once

#include "Records/Recording.h"
#include "UI/Quick/QuickFrontEnd.h"

#include <optional>
#include <string>

namespace spectrel {

/// The command line of `spectrel-gui`, read.
struct GraphicalArguments {
    std::optional<std::string> resources; // the templates' folder
    std::optional<std::string> logFile;
    std::optional<Appearance> appearance; // none: the desktop's
    std::optional<std::string> viewedFile; // none: the live session
    std::optional<Technology> technology; // of the file, where it does not tell
};

/// Reads the command line. An exit status when the program is done with that: after --help, --version or wrong usage,
/// each told on the stream where it belongs.
std::optional<int> readArguments(int argc, char** argv, GraphicalArguments& arguments);

} // namespace spectrel
