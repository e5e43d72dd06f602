#include "Monitor/Session.h"

#include "Platform/SystemLog.h"
#include "Platform/TelephonyProtocol.h"
#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <array>
#include <utility>

namespace spectrel {

namespace {

constexpr std::string_view Stars = " ***** ";

/// What is shown for a cause, and what the log line has around it. '#' stands for the code.
struct CauseText {
    SessionLossCause cause;
    std::string_view before;
    std::string_view shown;
    std::string_view behind;
};

using Cause = SessionLossCause;
constexpr std::array CauseTexts {
    CauseText {Cause::NoLocalPort, "", "Could not create local message port", ""},
    CauseText {Cause::LocalPortExists, "", "Local messsage port already exists", ""},
    CauseText {Cause::NoService, "", "Could not create RKServerConnection", ""},
    CauseText {Cause::ChannelRefused, "", "_RKServerConnectionNetworkMonitorCreateLogChannel returns error: #", "!"},
    CauseText {Cause::NoChannel, "", "Could not create a log channel (RK returned null port)", "!"},
    CauseText {Cause::NoRemotePort, "", "Could not create the remote port", "!"},
    CauseText {Cause::RequestNotMade, " ", "Could not generate GetTechnology command; cannot configure", ""},
    CauseText {Cause::RequestNotSent, Stars, "Could not send the GetTechnology command (got error=#)", ""},
    CauseText {Cause::NoReply, Stars, "No response to GetTechnology; cannot configure", ""},
    CauseText {Cause::ReplyNotRead, Stars, "Could not parse reply to GetTechnology; cannot configure", ""},
    CauseText {Cause::NoAnswer, Stars, "Reply to GetTechnology had no answer; cannot configure", ""},
    CauseText {Cause::UnknownTechnology, "", "No log generator technology works", ""},
    CauseText {Cause::CommandNotMade, " ", "Could not generate PLIST", ""},
    CauseText {Cause::CommandNotSent, Stars, "Could not send the START command (got error=#)", ""},
    CauseText {Cause::NoPorts, "", "Could not create the ports necessary", ""},
};

ByteView bytesOf(const std::string& text)
{
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

} // namespace

Session::Session(Services services, SessionSink& sink, std::string portPrefix)
    : _services(services)
    , _sink(sink)
    , _portPrefix(std::move(portPrefix))
{
}

Session::~Session()
{
    closePorts();
}

/// Logs a failure and remembers it. False, for whoever gives up.
bool Session::fail(SessionLossCause cause, std::int64_t code)
{
    const CauseText& texts = *std::ranges::find(CauseTexts, cause, &CauseText::cause);
    std::string shown(texts.shown);
    if (const std::size_t place = shown.find('#'); place != std::string::npos)
        shown.replace(place, 1, std::to_string(code));
    SPECTREL_LOG(_services.context.log, Priority::Error, "%s",
        (std::string(texts.before) + shown + std::string(texts.behind)).c_str());
    // The first failure of an attempt is the cause, those after it are what was given up for it.
    if (!std::exchange(_attemptHasCause, true))
        _loss = {cause, std::move(shown)};
    return false;
}

bool Session::createPorts()
{
    if (_portPrefix.empty())
        return false;
    const std::string localName = _portPrefix + std::string(PortSuffix);
    auto [port, existed] = _services.ports.createLocal(localName, [this](std::int32_t id, ByteView body) {
        handleMessage(id, body);
        return std::nullopt;
    });
    _recvPort = std::move(port);
    if (!_recvPort)
        return fail(Cause::NoLocalPort);
    if (existed)
        return fail(Cause::LocalPortExists);
    _recvPort->serve();
    _recvPort->setInvalidationHandler([this, handle = _recvPort.get()] { handleInvalidation(handle); });

    std::string serviceName;
    if (!openLogChannel(localName, serviceName))
        return false;
    _sendPort = _services.ports.createRemote(serviceName);
    if (!_sendPort)
        return fail(Cause::NoRemotePort);
    SPECTREL_LOG(_services.context.log, Priority::Error, " ***** Created ports (send=%p, recv=%p)",
        static_cast<void*>(_sendPort.get()), static_cast<void*>(_recvPort.get()));
    return true;
}

bool Session::openLogChannel(const std::string& localName, std::string& serviceName)
{
    // The connection lives only for this call; a notification may come while it does.
    const auto connection = _services.telephony.RKServerConnectionCreate([this](std::string_view) { refresh(); });
    if (!connection)
        return fail(Cause::NoService);
    const LogChannelResult result = connection->RKServerConnectionNetworkMonitorCreateLogChannel(localName);
    if (result.error != 0)
        return fail(Cause::ChannelRefused, result.error);
    if (!result.portName || result.portName->empty())
        return fail(Cause::NoChannel);
    serviceName = *result.portName;
    return true;
}

/// None when there was no answer, which is logged.
std::optional<Value> Session::askTechnology()
{
    const auto refuse = [this](SessionLossCause cause, std::int64_t code = 0) {
        fail(cause, code);
        return std::nullopt;
    };
    const auto request = serialisePropertyList(
        Dictionary::make({{TelephonyProtocol::GetTechnologyKey, TelephonyProtocol::GetTechnologyKey}}));
    if (!request)
        return refuse(Cause::RequestNotMade);
    std::optional<Bytes> reply;
    const SendStatus status = _sendPort->sendRequest(
        TelephonyProtocol::LogChannelId, bytesOf(*request), RequestTimeout, RequestTimeout, ReplyMode::Wait, &reply);
    if (status != SendStatus::Success)
        return refuse(Cause::RequestNotSent, static_cast<int>(status));
    if (!reply)
        return refuse(Cause::NoReply);
    const auto answer = parsePropertyList(*reply);
    if (!answer || !answer->dictionary())
        return refuse(Cause::ReplyNotRead);
    const Value& technology = (*answer->dictionary())[TelephonyProtocol::GetTechnologyKey];
    if (technology.isAbsent())
        return refuse(Cause::NoAnswer);
    return technology;
}

void Session::configureGenerator()
{
    const auto technology = askTechnology();
    if (!technology)
        return;
    _technology = technology->string() ? *technology->string() : std::string();
    _sink.useTechnology(*technology);
    SPECTREL_LOG(
        _services.context.log, Priority::Error, "Got log generated: %p", static_cast<void*>(_sink.generator()));
}

bool Session::open()
{
    _attemptHasCause = false;
    if (!createPorts())
        return fail(Cause::NoPorts);
    configureGenerator();
    if (!_sink.generator())
        return fail(Cause::UnknownTechnology);
    const auto command = serialisePropertyList(_sink.generator()->getStartCommand());
    if (!command)
        return fail(Cause::CommandNotMade);
    const SendStatus status = _sendPort->sendRequest(TelephonyProtocol::LogChannelId, bytesOf(*command), RequestTimeout,
        std::chrono::nanoseconds::zero(), ReplyMode::None, nullptr);
    return status == SendStatus::Success || fail(Cause::CommandNotSent, static_cast<int>(status));
}

void Session::start()
{
    if (_displayUpdateTimer)
        return;
    if (open()) {
        SPECTREL_LOG(_services.context.log, Priority::Error, "Starting the display update timer");
        _displayUpdateTimer = _services.runLoop.repeat(DisplayState::RefreshInterval, [this] { refresh(); });
        _loss = {};
    } else {
        destroyPorts();
        _services.runLoop.after(RetryDelay, _lifetime.guard([this] { start(); }));
    }
    announceChange();
}

void Session::closePorts()
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

void Session::destroyPorts()
{
    closePorts();
    announceChange();
}

void Session::restart()
{
    destroyPorts();
    start();
}

void Session::pause()
{
    if (!_recvPort || !_displayUpdateTimer)
        return;
    _recvPort->setPaused(true);
    _isPaused = true;
}

void Session::refresh()
{
    if (std::exchange(_isPaused, false) && _recvPort)
        _recvPort->setPaused(false);
    if (_sendPort && _recvPort && !_sendPort->isValid()) {
        const auto port = _recvPort; // the handler, still installed, restarts the session and lets go of the port
        port->invalidate();
    }
    _sink.sessionDidTick();
}

void Session::handleMessage(std::int32_t id, ByteView body) noexcept
{
    // Nothing catches what a record raises: the process ends here, and the terminate handler finds the message.
    if (id == TelephonyProtocol::LogChannelId)
        _sink.receive(body);
}

void Session::handleInvalidation(const LocalMessagePort* port)
{
    SPECTREL_LOG(_services.context.log, Priority::Error, " ***** INVALIDATED %p *****", static_cast<const void*>(port));
    restart();
}

/// Informs the sink when the session came or went, or the reason for its absence has changed.
void Session::announceChange()
{
    const bool isRunning = _displayUpdateTimer != nullptr;
    if (isRunning == _announcedRunning && _loss.text == _announcedText)
        return;
    _announcedRunning = isRunning;
    _announcedText = _loss.text;
    _sink.sessionDidChange();
}

} // namespace spectrel
