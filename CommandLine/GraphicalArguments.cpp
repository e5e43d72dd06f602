#include "CommandLine/GraphicalArguments.h"

#include "CommandLine/ExitStatus.h"

#include <CLI/CLI.hpp>
#include <iostream>
#include <map>

namespace spectrel {

namespace {

const std::map<std::string, std::optional<Appearance>> Appearances {
    {"desktop", std::nullopt}, {"light", Appearance::Light}, {"dark", Appearance::Dark}};

} // namespace

std::optional<int> readArguments(int argc, char** argv, GraphicalArguments& arguments)
{
    CLI::App program("Live radio diagnostics: the graphical screens, as 'spectrel --gui' opens them.", "spectrel-gui");
    program.footer("'spectrel --help' tells the environment and the exit statuses.");
    program.set_version_flag("--version", "spectrel " SPECTREL_VERSION);
    program.add_option("--resources", arguments.resources, "Take the display templates from this folder")
        ->check(CLI::ExistingDirectory)
        ->type_name("DIR");
    program.add_option("--log", arguments.logFile, "Write every system-log line to this file: <PRIORITY>TEXT")
        ->type_name("FILE");
    program.add_option("--view", arguments.viewedFile, "Browse this recording or snapshot, as 'spectrel view' does")
        ->type_name("FILE");
    program
        .add_option_function<std::string>(
            "--technology", [&arguments](const std::string& name) { arguments.technology = technologyNamed(name); },
            "The file's technology, where it does not tell")
        ->check(CLI::IsMember({"ifx", "gsm", "cdma", "lte", "utran"}));
    program
        .add_option_function<std::string>(
            "--appearance", [&arguments](const std::string& name) { arguments.appearance = Appearances.at(name); },
            "Light or dark, whatever the desktop is")
        ->check(CLI::IsMember(Appearances))
        ->type_name("light|dark|desktop");
    try {
        program.parse(argc, argv);
    } catch (const CLI::Success& answered) {
        return program.exit(answered); // --help and --version, on standard output
    } catch (const CLI::ParseError& error) {
        std::cerr << "spectrel-gui: " << error.what() << " (see spectrel-gui --help)\n";
        return ExitStatus::WrongUsage;
    }
    return std::nullopt;
}

} // namespace spectrel
