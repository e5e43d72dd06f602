#include "CommandLine/Graphical/GraphicalArguments.h"

#include "CommandLine/Options/OptionTypes.h"
#include "CommandLine/Program/ExitStatus.h"

#include <CLI/CLI.hpp>
#include <iostream>
#include <string_view>

namespace spectrel {

namespace {

/// The inner value is none where the desktop decides.
std::optional<std::optional<Appearance>> appearanceNamed(std::string_view name)
{
    if (name == "desktop")
        return std::optional<Appearance>();
    if (name == "light")
        return Appearance::Light;
    return name == "dark" ? std::optional<std::optional<Appearance>>(Appearance::Dark) : std::nullopt;
}

constexpr OptionForm<std::optional<Appearance>> AppearanceForm {
    "light|dark|desktop", appearanceNamed, "is not one of light, dark, desktop"};

} // namespace

std::optional<int> readArguments(int argc, char** argv, GraphicalArguments& arguments)
{
    CLI::App program("Live radio diagnostics: the graphical screens, as 'spectrel --gui' opens them.", "spectrel-gui");
    program.footer("'spectrel --help' tells the environment and the exit statuses.");
    program.set_version_flag("--version", "spectrel " SPECTREL_VERSION);
    addFormedOption(
        program, "--resources", arguments.resources, FolderForm, "Take the display templates from this folder");
    addFormedOption(
        program, "--log", arguments.logFile, FileForm, "Write every system-log line to this file: <PRIORITY>TEXT");
    addFormedOption(program, "--view", arguments.viewedFile, FileForm,
        "Browse this recording or snapshot, as 'spectrel view' does");
    addFormedOption(
        program, "--technology", arguments.technology, TechnologyForm, "The file's technology, where it does not tell");
    addFormedOption(
        program, "--appearance", arguments.appearance, AppearanceForm, "Light or dark, whatever the desktop is");
    try {
        program.parse(argc, argv);
    } catch (const CLI::Success& answered) {
        program.exit(answered); // --help and --version, on standard output
        if (std::cout.flush())
            return ExitStatus::Done;
        std::cerr << "spectrel-gui: standard output: cannot be written\n";
        return ExitStatus::Failed;
    } catch (const CLI::ParseError& error) {
        std::cerr << "spectrel-gui: " << error.what() << " (see spectrel-gui --help)\n";
        return ExitStatus::WrongUsage;
    }
    return std::nullopt;
}

} // namespace spectrel
