// spectrel-telephonyd: this platform's telephony service.

#include "CommandLine/OptionTypes.h"
#include "Platform/Environment.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Qt/TerminationSignals.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Telephony/ReplaySource.h"
#include "Telephony/Simulator/SimulatedRecording.h"
#include "Telephony/Simulator/SimulatorSource.h"
#include "Telephony/TelephonyService.h"

#include <CLI/CLI.hpp>
#include <cstdio>
#include <iostream>
#include <unistd.h>

namespace {

using namespace spectrel;

constexpr int ExitFailed = 1;
constexpr int ExitWrongUsage = 2;

constexpr const char* Description =
    "The telephony service: opens log channels and streams log messages from a simulated baseband or a recording.\n"
    "Ports are met in $SPECTREL_PORT_DIR (default: $XDG_RUNTIME_DIR/spectrel).";

struct SimulateOptions {
    std::optional<Technology> technology;
    Scene scene = Scene::Drive;
    std::uint32_t seed = 1;
    double rate = 1;
    std::string file; // write a recording and end
    std::chrono::milliseconds duration = std::chrono::minutes(1);
};

struct Options {
    SimulateOptions simulate;
    ReplayOptions replay;
    int readyDescriptor = -1;
};

const CLI::Validator IsScene(
    [](std::string& name) {
        Scene scene;
        return sceneNamed(name, scene) ? std::string() : "'" + name + "' is not one of still, walk, drive, stress";
    },
    "still|walk|drive|stress");

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

void describe(CLI::App& program, Options& options)
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
    auto* replay = source->add_option("--replay", options.replay.files,
        "Recordings (captures, snapshots, DLF files), one after the other, to each channel from their start");
    source->require_option(1);
    describeSimulation(program, *simulate, options.simulate);
    program
        .add_option("--speed", options.replay.speed,
            "With --replay: times as fast as recorded; 0 is as fast as a client takes it (default: 1)")
        ->check(CLI::NonNegativeNumber)
        ->needs(replay);
    program.add_flag("--loop", options.replay.loop, "With --replay: begin anew at the end")->needs(replay);
    program
        .add_option_function<std::string>(
            "--technology", [&options](const std::string& name) { options.replay.technology = technologyNamed(name); },
            "With --replay: the technology, where a file does not tell")
        ->check(IsTechnology)
        ->needs(replay);
    program
        .add_option("--ready-fd", options.readyDescriptor, "Write a line to this descriptor once the port is served")
        ->type_name("N");
}

int fail(const std::string& line)
{
    std::cerr << "spectrel-telephonyd: " << line << '\n';
    return ExitFailed;
}

std::unique_ptr<Baseband> makeBaseband(const SimulateOptions& options, std::string& reason)
{
    auto baseband = makeBaseband(*options.technology, options.scene, options.seed);
    if (!baseband)
        reason = "there is no simulated baseband of technology " + std::string(technologyName(*options.technology));
    return baseband;
}

std::unique_ptr<LogSource> makeSource(Options& options, RunLoop& runLoop, const Clock& clock, std::string& reason)
{
    if (!options.simulate.technology)
        return ReplaySource::open(runLoop, clock, std::move(options.replay), reason);
    auto baseband = makeBaseband(options.simulate, reason);
    return baseband ? std::make_unique<SimulatorSource>(runLoop, clock, std::move(baseband), options.simulate.rate)
                    : nullptr;
}

int writeRecording(const SimulateOptions& options)
{
    std::string reason;
    const auto baseband = makeBaseband(options, reason);
    if (!baseband)
        return fail(reason);
    return writeSimulatedRecording(*baseband, options.file, options.duration, reason)
        ? 0
        : fail(options.file + ": " + reason);
}

int serve(Options& options)
{
    QtRunLoop runLoop;
    const QtClock clock;
    SocketMessagePorts ports(Places::portDirectory());
    std::string reason;
    const auto source = makeSource(options, runLoop, clock, reason);
    if (!source)
        return fail(reason);
    TelephonyService service(runLoop, ports, *source);
    if (!service.start())
        return fail("cannot take the telephony service's port in " + Places::portDirectory()
            + ": another service runs there, or the folder is not this user's own");
    const TerminationSignals terminationSignals([&runLoop](int) { runLoop.quit(); });
    if (options.readyDescriptor >= 0) {
        if (::write(options.readyDescriptor, "ready\n", 6) != 6)
            return fail("--ready-fd: the descriptor cannot be written");
        ::close(options.readyDescriptor);
    }
    runLoop.run();
    return 0;
}

} // namespace

int main(int argc, char** argv)
{
    Options options;
    CLI::App program(Description, "spectrel-telephonyd");
    describe(program, options);
    try {
        program.parse(argc, argv);
    } catch (const CLI::Success& answered) {
        return program.exit(answered);
    } catch (const CLI::ParseError& error) {
        std::cerr << "spectrel-telephonyd: " << error.what() << " (see spectrel-telephonyd --help)\n";
        return ExitWrongUsage;
    }
    return options.simulate.file.empty() ? serve(options) : writeRecording(options.simulate);
}
