// spectrel-telephonyd: this platform's telephony service.

#include "CommandLine/Service/ServiceOptions.h"
#include "CommandLine/Service/TruthFile.h"
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

Result<std::unique_ptr<Baseband>> makeBaseband(const SimulateOptions& options)
{
    auto baseband = makeBaseband(*options.technology, options.scene, options.seed);
    if (!baseband)
        return Failure {
            "there is no simulated baseband of technology " + std::string(technologyName(*options.technology))};
    return baseband;
}

using MadeSource = Result<std::unique_ptr<LogSource>>;

MadeSource relay(const ServiceOptions& options, QtRunLoop& runLoop)
{
    auto input = openStreamInput(options.relay);
    if (!input)
        return input.failure();
    return std::make_unique<RelaySource>(
        runLoop, *std::move(input), options.technology, [&runLoop] { runLoop.quit(ExitFailed); });
}

MadeSource listenToModem(const std::string& wish, QtRunLoop& runLoop, const Clock& clock)
{
    auto service = ModemManagerService::open();
    if (!service)
        return service.failure();
    return std::make_unique<ModemSource>(runLoop, clock, *std::move(service), wish);
}

MadeSource simulate(const SimulateOptions& options, QtRunLoop& runLoop, const Clock& clock)
{
    auto baseband = makeBaseband(options);
    if (!baseband)
        return baseband.failure();
    return std::make_unique<SimulatorSource>(runLoop, clock, *std::move(baseband), options.rate);
}

MadeSource makeSource(ServiceOptions& options, QtRunLoop& runLoop, const Clock& clock)
{
    if (!options.relay.empty())
        return relay(options, runLoop);
    if (options.modem)
        return listenToModem(*options.modem, runLoop, clock);
    if (options.simulate.technology)
        return simulate(options.simulate, runLoop, clock);
    options.replay.technology = options.technology;
    return ReplaySource::open(runLoop, clock, std::move(options.replay));
}

int writeRecording(const SimulateOptions& options)
{
    const auto baseband = makeBaseband(options);
    if (!baseband)
        return fail(baseband.failure().text);
    std::unique_ptr<TruthFile> truth;
    if (!options.truth.empty()) {
        auto created = TruthFile::create(options.truth);
        if (!created)
            return fail(created.failure().of(options.truth).text);
        truth = *std::move(created);
    }
    const auto written =
        writeSimulatedRecording(**baseband, options.file, options.duration, [&truth](Moment time, const Move& move) {
            if (truth)
                truth->write(time, move);
        });
    if (!written)
        return fail(written.failure().text);
    if (const auto finished = truth ? truth->finish() : Done(); !finished)
        return fail(finished.failure().of(options.truth).text);
    return 0;
}

/// Serves the socket that the service manager has passed on, if it has.
Outcome adoptSocket(ServiceManager& manager, SocketMessagePorts& ports)
{
    auto socket = manager.takeListeningSocket();
    if (!socket)
        return socket.failure();
    return *socket ? ports.adopt(TelephonyProtocol::ServicePort, *std::move(socket)) : Done();
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
    const std::string folder = Places::portDirectory();
    if (const auto prepared = SocketMessagePorts::prepareDirectory(folder, TelephonyProtocol::ServicePort); !prepared)
        return fail(prepared.failure().of("the message ports' folder cannot be had").text);
    SocketMessagePorts ports(folder, SystemLog::none());
    if (const auto adopted = adoptSocket(manager, ports); !adopted)
        return fail(adopted.failure().text);
    const auto made = makeSource(options, runLoop, clock);
    if (!made)
        return fail(made.failure().text);
    LogSource& source = **made;
    TelephonyService service(runLoop, clock, ports, source);
    if (!service.start())
        return fail("cannot take the telephony service's port in " + folder + ": another service runs there");
    StatusReport report(clock, service, source);
    const TerminationSignals terminationSignals(
        [&](int signal) { signal == SIGUSR1 ? printStatus(report) : runLoop.quit(); }, {SIGUSR1});
    std::optional<RegularReport> regularReport;
    if (options.statusInterval)
        regularReport.emplace(runLoop, report, *options.statusInterval);
    ManagerStatus managerStatus(runLoop, manager, service, report);
    printServiceLine("serving in " + folder + ": " + source.status());
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
