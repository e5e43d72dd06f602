#pragma once

#include "Values/Result.h"

#include <string>

namespace spectrel {

/// The places that the environment chooses, each with its default; nothing is created here.
struct Places {
    static std::string portDirectory(); // $SPECTREL_PORT_DIR, $XDG_RUNTIME_DIR/spectrel, a private temporary folder
    static std::string devicePath(const std::string& absolutePath); // below $SPECTREL_DEVICE_ROOT
    static std::string crashLogDirectory(); // $SPECTREL_CRASH_LOG_DIR, $XDG_STATE_HOME/spectrel/CrashReporter
    static std::string diagnosticLog(); // the file $SPECTREL_DIAGNOSTIC_LOG; empty: none
    static std::string preferencesDirectory(); // $XDG_CONFIG_HOME/spectrel
    static std::string resourcesDirectory(); // Resources/ beside the program, the installed data directory otherwise
};

/// Makes a private folder (mode 0700) with its parents. One that is there stays as it is: it may be read by others.
/// Fails, naming the folder, when it cannot be made, belongs to somebody else, is a link, or can be written by others.
Outcome makePrivateDirectory(const std::string& path);

} // namespace spectrel
