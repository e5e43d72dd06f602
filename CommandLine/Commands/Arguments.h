#pragma once

#include "CommandLine/Commands/Channel.h"
#include "CommandLine/Commands/Decode.h"
#include "CommandLine/Commands/Mark.h"
#include "CommandLine/Commands/Record.h"
#include "CommandLine/Commands/Report.h"
#include "CommandLine/Commands/View.h"
#include "CommandLine/Commands/Watch.h"
#include "CommandLine/Program/ExitStatus.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

enum class Job : std::uint8_t { Application, Watch, Decode, View, Record, Channel, Mark, Report };

/// Which screens the application was asked to open; by default it finds out by itself.
enum class ScreenChoice : std::uint8_t { Automatic, Graphical, Terminal };

/// The command line of `spectrel`, read.
struct Arguments {
    Job job = Job::Application;
    ScreenChoice screens = ScreenChoice::Automatic;
    std::optional<std::string> resources; // the templates' folder
    std::optional<std::string> logFile;
    DecodeOptions decode;
    ViewOptions view;
    WatchOptions watch;
    RecordOptions record;
    ChannelOptions channel;
    MarkOptions mark;
    ReportOptions report;
};

/// Reads the command line. An exit status when the program is done with that: after --help, --version or wrong usage,
/// each reported on the stream where it belongs.
std::optional<int> readArguments(int argc, char** argv, Arguments& arguments);

} // namespace spectrel
