// spectrel-telephonyd: this platform's telephony service.

#include "Platform/Environment.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Qt/TerminationSignals.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Telephony/Modem/ModemManager/ModemManagerService.h"
#include "Telephony/Modem/ModemSource.h"
#include "Telephony/ReplaySource.h"
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
    "The telephony service: opens log channels and streams log messages from a simulated baseband, a recording\n"
    "or a modem.\n"
    "Ports are met in $SPECTREL_PORT_DIR (default: $XDG_RUNTIME_DIR/spectrel).";

struct Options {
    std::string simulate;
    std::optional<std::string> modem; // which one; empty: any
    std::uint32_t seed = 1;
    double rate = 1;
    ReplayOptions replay;
    int readyDescriptor = -1;
};

const CLI::Validator IsTechnology(
    [](std::string& name) {
        return technologyNamed(name) ? std::string() : "'" + name + "' is not one of ifx, gsm, cdma, lte, utran";
    },
    "ifx|gsm|cdma|lte|utran");

void describe(CLI::App& program, Options& options)
{
    program.set_version_flag("--version", "spectrel-telephonyd " SPECTREL_VERSION);
    auto* source = program.add_option_group("Source", "One of");
    auto* simulate = source->add_option("--simulate", options.simulate, "A simulated baseband of this technology")
                         ->check(IsTechnology);
    auto* replay = source->add_option("--replay", options.replay.files,
        "Recordings (captures, snapshots, DLF files), one after the other, to each channel from their start");
    source
        ->add_option_function<std::string>(
            "--modem", [&options](const std::string& wish) { options.modem = wish; },
            "The modem that ModemManager has: its number, object path, model or control port (default: one that is "
            "registered)")
        ->expected(0, 1)
        ->type_name("[NAME]");
    source->require_option(1);
    program.add_option("--seed", options.seed, "With --simulate: the same seed gives the same drive (default: 1)")
        ->needs(simulate);
    program.add_option("--rate", options.rate, "With --simulate: simulated seconds in one (default: 1)")
        ->check(CLI::Range(0.01, 1000.0))
        ->needs(simulate);
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

std::unique_ptr<LogSource> makeSource(Options& options, RunLoop& runLoop, const Clock& clock, std::string& reason)
{
    if (options.modem) {
        auto service = ModemManagerService::open(reason);
        return service ? std::make_unique<ModemSource>(runLoop, clock, std::move(service), *options.modem) : nullptr;
    }
    if (options.simulate.empty())
        return ReplaySource::open(runLoop, clock, std::move(options.replay), reason);
    if (options.simulate == technologyName(Technology::LTE))
        return std::make_unique<SimulatorSource>(runLoop, clock, options.seed, options.rate);
    reason = "there is no simulated baseband of technology " + options.simulate + " yet";
    return nullptr;
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
    return serve(options);
}
