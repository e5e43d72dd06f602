#include "CommandLine/Commands/Screens.h"

#include "CommandLine/Program/ErrorLine.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <system_error>
#include <unistd.h>

namespace spectrel {

namespace {

bool isSet(const char* variable)
{
    const char* value = std::getenv(variable);
    return value && *value;
}

std::string graphicalProgram()
{
    std::error_code error;
    const auto program = std::filesystem::read_symlink("/proc/self/exe", error);
    return (program.parent_path() / "spectrel-gui").string();
}

} // namespace

std::optional<Screens> findScreens(ScreenChoice choice)
{
    if (choice == ScreenChoice::Graphical)
        return Screens::Graphical;
    const bool hasTerminal = ::isatty(STDIN_FILENO) && ::isatty(STDOUT_FILENO);
    if (choice == ScreenChoice::Terminal) {
        if (hasTerminal)
            return Screens::Terminal;
        report("cannot open the terminal screens: standard input and output are no terminal");
        return std::nullopt;
    }
    const bool hasDisplay = isSet("WAYLAND_DISPLAY") || isSet("DISPLAY");
    if (hasDisplay && ::access(graphicalProgram().c_str(), X_OK) == 0)
        return Screens::Graphical;
    return hasTerminal ? Screens::Terminal : Screens::None;
}

int runGraphical(const Arguments& arguments, std::vector<std::string> options)
{
    const std::string program = graphicalProgram();
    options.insert(options.begin(), program);
    if (arguments.resources)
        options.push_back("--resources=" + *arguments.resources);
    if (arguments.logFile)
        options.push_back("--log=" + *arguments.logFile);
    std::vector<char*> given;
    for (std::string& option : options)
        given.push_back(option.data());
    given.push_back(nullptr);
    ::execv(program.c_str(), given.data());
    report("cannot open the graphical screens: " + program + ": " + std::strerror(errno));
    return ExitStatus::Failed;
}

} // namespace spectrel
