// spectrel-telephonyd: this platform's telephony service.

#include "CommandLine/Service/ServiceOptions.h"
#include "Platform/Places.h"
#include "Platform/Qt/QtClock.h"
#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Qt/TerminationSignals.h"
#include "Platform/Sockets/OpenStreamInput.h"
#include "Platform/Sockets/ServiceManager.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Platform/TelephonyProtocol.h"
#include "Telephony/Modem/ModemManager/ModemManagerService.h"
#include "Telephony/Modem/ModemSource.h"
#include "Telephony/ServiceLine.h"
#include "Telephony/Simulator/SimulatedRecording.h"
#include "Telephony/Sources/RelaySource.h"
#include "Telephony/Sources/ReplaySource.h"
#include "Telephony/Sources/SimulatorSource.h"
#include "Telephony/StatusReport.h"
#include "Telephony/TelephonyService.h"

#include <csignal>
#include <optional>
#include <unistd.h>

namespace {

using namespace spectrel;

constexpr int ExitFailed = 1;

int fail(const std::string& line)
{
    printServiceLine(line);
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
    if (options.modem) {
        auto service = ModemManagerService::open(reason);
        return service ? std::make_unique<ModemSource>(runLoop, clock, std::move(service), *options.modem) : nullptr;
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

/// Serves the socket that the service manager has passed on, if it has.
bool adoptSocket(ServiceManager& manager, SocketMessagePorts& ports, std::string& reason)
{
    FileDescriptor socket = manager.takeListeningSocket(reason);
    return socket ? ports.adopt(TelephonyProtocol::ServicePort, std::move(socket), reason) : reason.empty();
}

bool writeReady(int descriptor)
{
    if (descriptor < 0)
        return true;
    const bool isWritten = ::write(descriptor, "ready\n", 6) == 6;
    ::close(descriptor);
    return isWritten;
}

/// Keeps the service manager's status line true.
class ManagerStatus {
public:
    ManagerStatus(
        RunLoop& runLoop, const ServiceManager& manager, TelephonyService& service, const StatusReport& report)
        : _manager(manager)
        , _report(report)
    {
        if (!manager.isListening())
            return;
        service.setChangeHandler([this] { notifyManager(); });
        _timer = runLoop.repeat(Interval, [this] { notifyManager(); });
    }
    void notifyManager(const std::string& before = "")
    {
        const std::string headline = _report.headline();
        if (!before.empty() || headline != _headline)
            _manager.notify(before + "STATUS=" + headline + "\n");
        _headline = headline;
    }

private:
    static constexpr std::chrono::seconds Interval {10};
    const ServiceManager& _manager;
    const StatusReport& _report;
    std::unique_ptr<Timer> _timer;
    std::string _headline;
};

int serve(ServiceOptions& options)
{
    ServiceManager manager;
    QtRunLoop runLoop;
    QtClock clock;
    Clock::install(&clock);
    std::string reason;
    if (!SocketMessagePorts::prepareDirectory(Places::portDirectory(), TelephonyProtocol::ServicePort, reason))
        return fail("the message ports' folder cannot be had: " + reason);
    SocketMessagePorts ports(Places::portDirectory());
    if (!adoptSocket(manager, ports, reason))
        return fail(reason);
    const auto source = makeSource(options, runLoop, clock, reason);
    if (!source)
        return fail(reason);
    TelephonyService service(runLoop, ports, *source);
    if (!service.start())
        return fail(
            "cannot take the telephony service's port in " + Places::portDirectory() + ": another service runs there");
    StatusReport report(clock, service, *source);
    const TerminationSignals terminationSignals(
        [&](int signal) { signal == SIGUSR1 ? printStatus(report) : runLoop.quit(); }, {SIGUSR1});
    std::optional<RegularReport> regularReport;
    if (options.statusInterval)
        regularReport.emplace(runLoop, report, *options.statusInterval);
    ManagerStatus managerStatus(runLoop, manager, service, report);
    printServiceLine("serving in " + Places::portDirectory() + ": " + source->status());
    if (!writeReady(options.readyDescriptor))
        return fail("--ready-fd: the descriptor cannot be written");
    managerStatus.notifyManager("READY=1\n");
    const int status = runLoop.run();
    manager.notify("STOPPING=1\n");
    service.setChangeHandler({});
    return status;
}

} // namespace

int main(int argc, char** argv)
{
    ServiceOptions options;
    if (const auto status = readServiceOptions(argc, argv, options))
        return *status;
    return options.simulate.file.empty() ? serve(options) : writeRecording(options.simulate);
}
