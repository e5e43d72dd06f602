#include "Telephony/ServiceOptions.h"

#include "CommandLine/OptionTypes.h"

#include <CLI/CLI.hpp>
#include <iostream>
#include <tuple>

namespace spectrel {

namespace {

constexpr int ExitWrongUsage = 2;

constexpr const char* Description =
    "The telephony service: opens log channels and streams log messages from a simulated baseband, a recording,\n"
    "a live stream or a modem.\n"
    "Ports are met in $SPECTREL_PORT_DIR (default: $XDG_RUNTIME_DIR/spectrel).";

const CLI::Validator IsScene(
    [](std::string& name) {
        Scene scene;
        return sceneNamed(name, scene) ? std::string() : "'" + name + "' is not one of still, walk, drive, stress";
    },
    "still|walk|drive|stress");

std::optional<ReplayPoint> parseReplayPoint(const std::string& text)
{
    if (const auto offset = parseDuration(text))
        return ReplayPoint::after(*offset);
    return ReplayPoint::wallClock(text);
}

void describeSimulation(CLI::App& program, CLI::Option& simulate, SimulateOptions& options)
{
    program
        .add_option_function<std::string>(
            "--scene", [&options](const std::string& name) { sceneNamed(name, options.scene); },
            "With --simulate: how the phone moves; stress sends every record ten times a second (default: drive)")
        ->check(IsScene)
        ->needs(&simulate);
    program.add_option("--seed", options.seed, "With --simulate: the same seed gives the same drive (default: 1)")
        ->needs(&simulate);
    auto* rate = program.add_option("--rate", options.rate, "With --simulate: simulated seconds in one (default: 1)")
                     ->check(CLI::Range(0.01, 1000.0))
                     ->needs(&simulate);
    auto* write = program
                      .add_option("--write", options.file,
                          "With --simulate: write a recording into this file, without waiting, and end")
                      ->type_name("FILE")
                      ->needs(&simulate)
                      ->excludes(rate);
    program
        .add_option_function<std::string>(
            "--duration", [&options](const std::string& text) { options.duration = *parseDuration(text); },
            "With --write: the length of the recording, such as 2h (default: 1m)")
        ->check(IsDuration)
        ->needs(write);
}

const CLI::Validator IsReplayPoint(
    [](std::string& text) {
        return parseReplayPoint(text) ? std::string()
                                      : "'" + text
                + "' is neither a time into the recording such as 90s nor a time such as '2024-03-05 14:07:31'";
    },
    "TIME");

void describeReplay(CLI::App& program, CLI::Option& replay, ReplayOptions& options)
{
    program
        .add_option("--speed", options.speed,
            "With --replay: times as fast as recorded; 0 is as fast as a client takes it (default: 1)")
        ->check(CLI::NonNegativeNumber)
        ->needs(&replay);
    program
        .add_option_function<std::string>(
            "--from", [&options](const std::string& text) { options.from = parseReplayPoint(text); },
            "With --replay: begin here: a time into the recording (90s, 5m), or a time of day (14:07:31) or a date and "
            "time, local or with a zone (2024-03-05T13:07:31Z)")
        ->check(IsReplayPoint)
        ->needs(&replay);
    program
        .add_option_function<std::string>(
            "--to", [&options](const std::string& text) { options.to = parseReplayPoint(text); },
            "With --replay: end here, told likewise")
        ->check(IsReplayPoint)
        ->needs(&replay);
    program.add_flag("--loop", options.loop, "With --replay: begin anew at the end")->needs(&replay);
}

void describe(CLI::App& program, ServiceOptions& options)
{
    program.set_version_flag("--version", "spectrel-telephonyd " SPECTREL_VERSION);
    auto* source = program.add_option_group("Source", "One of");
    auto* simulate =
        source
            ->add_option_function<std::string>(
                "--simulate",
                [&options](const std::string& name) { options.simulate.technology = technologyNamed(name); },
                "A simulated baseband of this technology")
            ->check(IsTechnology);
    auto* replay =
        source
            ->add_option("--replay", options.replay.files,
                "Recordings (captures, snapshots, DLF files), one after the other, to each channel from their start")
            ->type_name("FILE");
    source
        ->add_option("--relay", options.relay,
            "A live stream of capture (pcap) or DLF bytes: - (standard input), a FIFO, unix:PATH or "
            "tcp:HOST:PORT to listen there (tcp:PORT: this machine alone)")
        ->type_name("ADDRESS");
    source
        ->add_option_function<std::string>(
            "--modem", [&options](const std::string& wish) { options.modem = wish; },
            "The modem that ModemManager has: its number, object path, model or control port (default: one that is "
            "registered)")
        ->expected(0, 1)
        ->type_name("[NAME]");
    source->require_option(1);
    describeSimulation(program, *simulate, options.simulate);
    describeReplay(program, *replay, options.replay);
    program
        .add_option_function<std::string>(
            "--technology", [&options](const std::string& name) { options.technology = technologyNamed(name); },
            "With --replay and --relay: the technology, where a file or the stream does not tell")
        ->check(IsTechnology)
        ->excludes(simulate);
    program
        .add_option_function<std::string>(
            "--status", [&options](const std::string& text) { options.statusInterval = parseDuration(text); },
            "Tell on standard error every so often, such as 10s, what is streamed to whom, when anything is; the "
            "signal "
            "USR1 asks for it at any time")
        ->check(IsDuration);
    program
        .add_option("--ready-fd", options.readyDescriptor, "Write a line to this descriptor once the port is served")
        ->type_name("N");
}

} // namespace

std::optional<int> readServiceOptions(int argc, char** argv, ServiceOptions& options)
{
    CLI::App program(Description, "spectrel-telephonyd");
    describe(program, options);
    try {
        program.parse(argc, argv);
        const auto& [from, to] = std::tie(options.replay.from, options.replay.to);
        if (from && to && from->isOffset() && to->isOffset() && from->offset() > to->offset())
            throw CLI::ValidationError("--to", "lies before --from");
    } catch (const CLI::Success& answered) {
        return program.exit(answered);
    } catch (const CLI::ParseError& error) {
        std::cerr << "spectrel-telephonyd: " << error.what() << " (see spectrel-telephonyd --help)\n";
        return ExitWrongUsage;
    }
    return std::nullopt;
}

} // namespace spectrel
