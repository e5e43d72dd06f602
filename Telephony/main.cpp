// spectrel-telephonyd: this platform's telephony service.

#include "Platform/Environment.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Qt/TerminationSignals.h"
#include "Platform/Sockets/OpenStreamInput.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Telephony/RelaySource.h"
#include "Telephony/ReplaySource.h"
#include "Telephony/ServiceOptions.h"
#include "Telephony/Simulator/SimulatedRecording.h"
#include "Telephony/Simulator/SimulatorSource.h"
#include "Telephony/TelephonyService.h"

#include <iostream>
#include <unistd.h>

namespace {

using namespace spectrel;

constexpr int ExitFailed = 1;

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

std::unique_ptr<LogSource> makeSource(
    ServiceOptions& options, QtRunLoop& runLoop, const Clock& clock, std::string& reason)
{
    if (!options.relay.empty()) {
        auto input = openStreamInput(options.relay, reason);
        return input ? std::make_unique<RelaySource>(
                   runLoop, std::move(input), options.technology, [&runLoop] { runLoop.quit(ExitFailed); })
                     : nullptr;
    }
    options.replay.technology = options.technology;
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

int serve(ServiceOptions& options)
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
    return runLoop.run();
}

} // namespace

int main(int argc, char** argv)
{
    ServiceOptions options;
    if (const auto status = readServiceOptions(argc, argv, options))
        return *status;
    return options.simulate.file.empty() ? serve(options) : writeRecording(options.simulate);
}
