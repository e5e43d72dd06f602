#include "Monitor/SpectrelModel.h"

#include "Platform/SystemLog.h"
#include "Platform/TelephonyProtocol.h"
#include "Values/PropertyList/PropertyList.h"

#include <cstdarg>
#include <cstdio>
#include <utility>

namespace spectrel {

namespace {

ByteView bytesOf(const std::string& text)
{
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

/// A log line as a person would read it: without the stars and blanks around it.
std::string undecorated(std::string_view line)
{
    const std::size_t first = line.find_first_not_of(" *");
    const std::size_t last = line.find_last_not_of(" *!");
    return first == std::string_view::npos ? std::string() : std::string(line.substr(first, last - first + 1));
}

} // namespace

SpectrelModel::SpectrelModel(Services services, SpectrelModelObserver& observer, std::string portPrefix)
    : _services(services)
    , _observer(observer)
    , _portPrefix(std::move(portPrefix))
    , _alive(std::make_shared<bool>(true))
{
}

SpectrelModel::~SpectrelModel()
{
    closePorts();
}

// ---- The session

bool SpectrelModel::isConnected() const
{
    return _recvPort && _sendPort;
}

/// Logs a failure and remembers the reason for the screens.
void SpectrelModel::fail(const char* format, ...)
{
    char line[256];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(line, sizeof line, format, arguments);
    va_end(arguments);
    SPECTREL_LOG(Priority::Error, "%s", line);
    // The first line of an attempt tells the cause, those after it what was given up for it.
    if (!std::exchange(_attemptHasReason, true))
        _lostReason = undecorated(line);
}

bool SpectrelModel::createPorts()
{
    if (_portPrefix.empty())
        return false;
    const std::string localName = _portPrefix + std::string(PortSuffix);
    auto [port, existed] = _services.ports.createLocal(localName, [this](std::int32_t id, ByteView body) {
        handleMessage(id, body);
        return std::nullopt;
    });
    _recvPort = std::move(port);
    if (!_recvPort) {
        fail("Could not create local message port");
        return false;
    }
    if (existed) {
        fail("Local messsage port already exists");
        return false;
    }
    _recvPort->serve();
    _recvPort->setInvalidationHandler([this, handle = _recvPort.get()] { handleInvalidation(handle); });

    std::string serviceName;
    if (!openLogChannel(localName, serviceName))
        return false;
    _sendPort = _services.ports.createRemote(serviceName);
    if (!_sendPort) {
        fail("Could not create the remote port!");
        return false;
    }
    SPECTREL_LOG(Priority::Error, " ***** Created ports (send=%p, recv=%p)", static_cast<void*>(_sendPort.get()),
        static_cast<void*>(_recvPort.get()));
    return true;
}

bool SpectrelModel::openLogChannel(const std::string& localName, std::string& serviceName)
{
    // The connection lives only for this call; a notification may come while it does.
    const auto connection = _services.telephony.RKServerConnectionCreate([this](std::string_view) { refresh(); });
    if (!connection) {
        fail("Could not create RKServerConnection");
        return false;
    }
    const LogChannelResult result = connection->RKServerConnectionNetworkMonitorCreateLogChannel(localName);
    if (result.error != 0) {
        fail("_RKServerConnectionNetworkMonitorCreateLogChannel returns error: %ld!", static_cast<long>(result.error));
        return false;
    }
    if (!result.portName || result.portName->empty()) {
        fail("Could not create a log channel (RK returned null port)!");
        return false;
    }
    serviceName = *result.portName;
    return true;
}

void SpectrelModel::configureGenerator()
{
    const auto request = serialisePropertyList(
        Dictionary::make({{TelephonyProtocol::GetTechnologyKey, TelephonyProtocol::GetTechnologyKey}}));
    if (!request) {
        fail(" Could not generate GetTechnology command; cannot configure");
        return;
    }
    std::optional<Bytes> reply;
    const SendStatus status = _sendPort->sendRequest(
        TelephonyProtocol::LogChannelId, bytesOf(*request), RequestTimeout, RequestTimeout, ReplyMode::Wait, &reply);
    if (status != SendStatus::Success) {
        fail(" ***** Could not send the GetTechnology command (got error=%d)", static_cast<int>(status));
        return;
    }
    if (!reply) {
        fail(" ***** No response to GetTechnology; cannot configure");
        return;
    }
    const auto answer = parsePropertyList(*reply);
    if (!answer || !answer->dictionary()) {
        fail(" ***** Could not parse reply to GetTechnology; cannot configure");
        return;
    }
    const Value& technology = (*answer->dictionary())[TelephonyProtocol::GetTechnologyKey];
    if (technology.isAbsent()) {
        fail(" ***** Reply to GetTechnology had no answer; cannot configure");
        return;
    }
    _technology = technology.string() ? *technology.string() : std::string();
    _display.useTechnology(technology);
    SPECTREL_LOG(Priority::Error, "Got log generated: %p", static_cast<void*>(_display.generator()));
}

bool SpectrelModel::startSession()
{
    _attemptHasReason = false;
    if (!createPorts()) {
        fail("Could not create the ports necessary");
        return false;
    }
    configureGenerator();
    if (!_display.generator()) {
        fail("No log generator technology works");
        return false;
    }
    const auto command = serialisePropertyList(_display.generator()->getStartCommand());
    if (!command) {
        fail(" Could not generate PLIST");
        return false;
    }
    const SendStatus status = _sendPort->sendRequest(TelephonyProtocol::LogChannelId, bytesOf(*command), RequestTimeout,
        std::chrono::nanoseconds::zero(), ReplyMode::None, nullptr);
    if (status != SendStatus::Success) {
        fail(" ***** Could not send the START command (got error=%d)", static_cast<int>(status));
        return false;
    }
    return true;
}

void SpectrelModel::startMonitor()
{
    if (_displayUpdateTimer)
        return;
    if (startSession()) {
        SPECTREL_LOG(Priority::Error, "Starting the display update timer");
        _displayUpdateTimer = _services.runLoop.repeat(RefreshInterval, [this] { refresh(); });
        _lostReason.clear();
    } else {
        destroyPorts();
        _services.runLoop.after(RetryDelay, whileAlive(&SpectrelModel::startMonitor));
    }
    announceChange();
}

void SpectrelModel::closePorts()
{
    _displayUpdateTimer.reset();
    // The handlers go first, so that a deliberate close does not start the session anew.
    if (const auto port = std::exchange(_recvPort, nullptr)) {
        port->setInvalidationHandler({});
        port->invalidate();
    }
    if (const auto port = std::exchange(_sendPort, nullptr)) {
        port->setInvalidationHandler({});
        port->invalidate();
    }
}

void SpectrelModel::destroyPorts()
{
    closePorts();
    announceChange();
}

void SpectrelModel::restartMonitor()
{
    destroyPorts();
    startMonitor();
}

void SpectrelModel::handleMessage(std::int32_t id, ByteView body) noexcept
{
    // Nothing catches what a record raises: the process ends here, and the terminate handler finds the message.
    if (id != TelephonyProtocol::LogChannelId)
        return;
    if (_observer.modelShouldApply(body))
        updateWithData(body);
}

void SpectrelModel::handleInvalidation(const LocalMessagePort* port)
{
    SPECTREL_LOG(Priority::Error, " ***** INVALIDATED %p *****", static_cast<const void*>(port));
    restartMonitor();
}

/// Tells the observer when the session came or went, or the reason for its absence has changed.
void SpectrelModel::announceChange()
{
    const bool isConnectedNow = _displayUpdateTimer != nullptr;
    if (isConnectedNow == _announcedConnected && _lostReason == _announcedReason)
        return;
    _announcedConnected = isConnectedNow;
    _announcedReason = _lostReason;
    _observer.sessionDidChange();
}

/// The operation as a job for the queue; the job does nothing once the model is gone.
RunLoop::Job SpectrelModel::whileAlive(void (SpectrelModel::*operation)())
{
    return [this, operation, alive = std::weak_ptr(_alive)] {
        if (!alive.expired())
            (this->*operation)();
    };
}

// ---- The display

void SpectrelModel::updateWithData(ByteView data)
{
    _display.apply(data, Clock::installed().now());
    _intake += data.size();
    if (_intake >= LargestIntake && _recvPort && _displayUpdateTimer)
        _recvPort->setPaused(true);
}

void SpectrelModel::refresh()
{
    if (_intake >= LargestIntake && _recvPort)
        _recvPort->setPaused(false);
    _intake = 0;
    if (_sendPort && _recvPort && !_sendPort->isValid()) {
        const auto port = _recvPort; // the handler, still installed, restarts the session and lets go of the port
        port->invalidate();
    }
    if (!_display.takeNews())
        return;
    _nodes.reset();
    _nodesByPath.reset();
    _services.runLoop.async(whileAlive(&SpectrelModel::reloadScreens));
}

void SpectrelModel::reloadScreens()
{
    _observer.updateViewControllerFromModel();
}

NodeRef SpectrelModel::topLevelNodes()
{
    if (_nodes || !_display.generator())
        return _nodes;
    const Value display = _display.build();
    _nodesByPath = std::make_unique<PathIndex>();
    _nodes = SpectrelModelNode::makeTreeFromObject(display, *_nodesByPath);
    return _nodes;
}

NodeRef SpectrelModel::nodeAtPath(std::string_view path)
{
    if (!_nodesByPath)
        topLevelNodes();
    return _nodesByPath ? nodeInIndex(*_nodesByPath, path) : nullptr;
}

ListRef SpectrelModel::getSaveContents()
{
    return _display.saveContents();
}

ListRef SpectrelModel::getLastContents()
{
    return _display.lastContents();
}

} // namespace spectrel
