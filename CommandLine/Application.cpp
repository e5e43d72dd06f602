#include "CommandLine/Application.h"

#include "CommandLine/Report.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <system_error>
#include <unistd.h>

namespace spectrel {

namespace {

bool isSet(const char* variable)
{
    const char* value = std::getenv(variable);
    return value && *value;
}

/// The program with the graphical screens stands beside this one where it is installed.
std::string graphicalProgram()
{
    std::error_code error;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", error);
    return (program.parent_path() / "spectrel-gui").string();
}

/// Becomes the graphical program; comes back only when that fails.
int runGraphical(const std::string& program)
{
    ::execl(program.c_str(), program.c_str(), static_cast<char*>(nullptr));
    report("cannot open the graphical screens: " + program + ": " + std::strerror(errno));
    return ExitStatus::Failed;
}

int runTerminal()
{
    return ExitStatus::Failed;
}

} // namespace

int runApplication(const Arguments& arguments)
{
    const std::string graphical = graphicalProgram();
    if (arguments.screens == ScreenChoice::Graphical)
        return runGraphical(graphical);
    const bool hasTerminal = ::isatty(STDIN_FILENO) && ::isatty(STDOUT_FILENO);
    if (arguments.screens == ScreenChoice::Terminal) {
        if (hasTerminal)
            return runTerminal();
        report("cannot open the terminal screens: standard input and output are no terminal");
        return ExitStatus::Failed;
    }
    const bool hasDisplay = isSet("WAYLAND_DISPLAY") || isSet("DISPLAY");
    if (hasDisplay && ::access(graphical.c_str(), X_OK) == 0)
        return runGraphical(graphical);
    return hasTerminal ? runTerminal() : watch(arguments.watch);
}

} // namespace spectrel
