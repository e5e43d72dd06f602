#include "CommandLine/Service/ServiceOptions.h"

#include "CommandLine/Options/OptionTypes.h"

#include <CLI/CLI.hpp>
#include <iostream>
#include <limits>
#include <tuple>

namespace spectrel {

namespace {

constexpr int ExitWrongUsage = 2;

constexpr const char* Description =
    "The telephony service: opens log channels and streams log messages from a simulated baseband, a recording,\n"
    "a live stream or a modem.\n"
    "Ports are met in $SPECTREL_PORT_DIR (default: $XDG_RUNTIME_DIR/spectrel).";

std::optional<Scene> parseScene(std::string_view name)
{
    Scene scene;
    return sceneNamed(name, scene) ? std::optional(scene) : std::nullopt;
}

std::optional<std::uint32_t> parseSeed(std::string_view text)
{
    return parseWholeNumber(text, 0, std::numeric_limits<std::uint32_t>::max());
}

std::optional<double> parseRate(std::string_view text)
{
    return parseNumber(text, 0.01, 1000);
}

std::optional<double> parseSpeed(std::string_view text)
{
    const auto speed = parseNumber(text, 0, 1e6);
    return speed > 0.0 && speed < 0.001 ? std::nullopt : speed;
}

std::optional<ReplayPoint> parseReplayPoint(std::string_view text)
{
    if (const auto offset = parseOffset(text))
        return ReplayPoint::after(*offset);
    return ReplayPoint::wallClock(text);
}

std::optional<int> parseDescriptor(std::string_view text)
{
    const auto number = parseWholeNumber(text, 0, std::numeric_limits<int>::max());
    return number ? std::optional(static_cast<int>(*number)) : std::nullopt;
}

std::optional<std::string> parseAddress(std::string_view text)
{
    return text.empty() ? std::nullopt : std::optional<std::string>(text);
}

constexpr OptionForm<std::uint32_t> SeedForm {"N", parseSeed, "is no whole number from 0 to 4294967295"};
constexpr OptionForm<double> RateForm {"FACTOR", parseRate, "is no number from 0.01 to 1000"};
constexpr OptionForm<double> SpeedForm {"FACTOR", parseSpeed, "is neither 0 nor a number from 0.001 to 1000000"};
constexpr OptionForm<ReplayPoint> ReplayPointForm {"TIME", parseReplayPoint,
    "is neither a time into the recording such as 90s nor a time such as '2024-03-05 14:07:31'"};
constexpr OptionForm<int> DescriptorForm {"N", parseDescriptor, "is no number of a descriptor"};
constexpr OptionForm<std::string> AddressForm {
    "ADDRESS", parseAddress, "is neither -, a FIFO, unix:PATH nor tcp:HOST:PORT"};

void describeSimulation(CLI::App& program, CLI::Option& simulate, SimulateOptions& options)
{
    static const std::string typeName = sceneNames("|"); // the option reads them later
    static const std::string complaint = "is not one of " + sceneNames(", ");
    addFormedOption(program, "--scene", options.scene,
        OptionForm<Scene> {typeName.c_str(), parseScene, complaint.c_str()},
        "With --simulate: what the phone goes through; stress sends every record ten times a second (default: drive)")
        ->needs(&simulate);
    addFormedOption(
        program, "--seed", options.seed, SeedForm, "With --simulate: the same seed gives the same drive (default: 1)")
        ->needs(&simulate);
    auto* rate = addFormedOption(
        program, "--rate", options.rate, RateForm, "With --simulate: simulated seconds in one (default: 1)")
                     ->needs(&simulate);
    auto* write = addFormedOption(program, "--write", options.file, FileForm,
        "With --simulate: write a recording into this file, without waiting, and end")
                      ->needs(&simulate)
                      ->excludes(rate);
    addFormedOption(program, "--duration", options.duration, DurationForm,
        "With --write: the length of the recording, such as 2h (default: 1m)")
        ->needs(write);
    addFormedOption(program, "--truth", options.truth, FileForm,
        "With --write: write into this file, in JSON Lines, which moves the simulated world decided and why")
        ->needs(write);
}

void describeReplay(CLI::App& program, CLI::Option& replay, ReplayOptions& options)
{
    addFormedOption(program, "--speed", options.speed, SpeedForm,
        "With --replay: times as fast as recorded; 0 is as fast as a client takes it (default: 1)")
        ->needs(&replay);
    addFormedOption(program, "--from", options.from, ReplayPointForm,
        "With --replay: begin here: a time into the recording (90s, 5m), or a time of day (14:07:31) or a date and "
        "time, local or with a zone (2024-03-05T13:07:31Z)")
        ->needs(&replay);
    addFormedOption(program, "--to", options.to, ReplayPointForm, "With --replay: end here, told likewise")
        ->needs(&replay);
    program.add_flag("--loop", options.loop, "With --replay: begin anew at the end")->needs(&replay);
}

void describe(CLI::App& program, ServiceOptions& options)
{
    program.set_version_flag("--version", "spectrel-telephonyd " SPECTREL_VERSION);
    CLI::App& source = *program.add_option_group("Source", "One of");
    auto* simulate = addFormedOption(
        source, "--simulate", options.simulate.technology, TechnologyForm, "A simulated baseband of this technology");
    auto* replay =
        source
            .add_option("--replay", options.replay.files,
                "Recordings (captures, snapshots, DLF files), one after the other, to each channel from their start")
            ->type_name("FILE");
    addFormedOption(source, "--relay", options.relay, AddressForm,
        "A live stream of capture (pcap) or DLF bytes: - (standard input), a FIFO, unix:PATH or "
        "tcp:HOST:PORT to listen there (tcp:PORT: this machine alone)");
    auto* modem =
        source
            .add_option_function<std::string>(
                "--modem", [&options](const std::string& wish) { options.modem = wish; },
                "The modem that ModemManager has: its number, object path, model or control port (default: one that is "
                "registered)")
            ->expected(0, 1)
            ->type_name("[NAME]");
    source.require_option(1);
    describeSimulation(program, *simulate, options.simulate);
    describeReplay(program, *replay, options.replay);
    addFormedOption(program, "--technology", options.technology, TechnologyForm,
        "With --replay and --relay: the technology, where a file or the stream does not tell")
        ->excludes(simulate)
        ->excludes(modem);
    addFormedOption(program, "--status", options.statusInterval, DurationForm,
        "Tell on standard error every so often, such as 10s, what is streamed to whom, when anything is; the signal "
        "USR1 asks for it at any time");
    addFormedOption(program, "--ready-fd", options.readyDescriptor, DescriptorForm,
        "Write a line to this descriptor once the port is served");
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
        const auto& [technology, scene] = std::tie(options.simulate.technology, options.simulate.scene);
        if (technology && !hasScene(*technology, scene))
            throw CLI::ValidationError("--scene",
                "'" + std::string(sceneName(scene)) + "' is there for " + technologiesOf(scene) + ", not for "
                    + std::string(technologyName(*technology)));
    } catch (const CLI::Success& answered) {
        return program.exit(answered);
    } catch (const CLI::ParseError& error) {
        std::cerr << "spectrel-telephonyd: " << error.what() << " (see spectrel-telephonyd --help)\n";
        return ExitWrongUsage;
    }
    return std::nullopt;
}

} // namespace spectrel
