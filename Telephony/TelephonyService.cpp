#include "Telephony/TelephonyService.h"

#include "Platform/TelephonyProtocol.h"
#include "Telephony/ServiceLine.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

namespace spectrel {

namespace {

namespace Protocol = TelephonyProtocol;
using Protocol::ChannelError;

Bytes answer(ChannelError error, const std::string& portName = {})
{
    const auto text = serialisePropertyList(Dictionary::make({
        {Protocol::DomainKey, Value::integer(error == ChannelError::None ? 0 : 1)},
        {Protocol::ErrorKey, Value::integer(static_cast<std::int32_t>(error))},
        {Protocol::PortNameKey, portName},
    }));
    return {text->begin(), text->end()};
}

} // namespace

TelephonyService::TelephonyService(RunLoop& runLoop, const Clock& clock, MessagePorts& ports, LogSource& source)
    : _runLoop(runLoop)
    , _clock(clock)
    , _ports(ports)
    , _source(source)
{
}

TelephonyService::~TelephonyService()
{
    _channels.clear();
    if (!_port)
        return;
    _source.setBasebandHandler({});
    _port->invalidate();
}

bool TelephonyService::start()
{
    const auto [port, existed] = _ports.createLocal(
        Protocol::ServicePort, [this](std::int32_t id, ByteView body) { return handleRequest(id, body); });
    if (!port || existed)
        return false;
    _port = port;
    _port->serve();
    _source.setBasebandHandler([this] { endChannels(); });
    return true;
}

/// Another baseband is to speak now: the clients are to ask for its technology, and choose their codes, anew.
void TelephonyService::endChannels()
{
    if (!_channels.empty())
        printServiceLine("ending " + std::to_string(_channels.size()) + " channel(s): their baseband has changed");
    _channels.clear();
    reportChange();
}

void TelephonyService::reportChange()
{
    if (_changeHandler)
        _changeHandler();
}

std::vector<ChannelStatus> TelephonyService::status() const
{
    std::vector<ChannelStatus> status;
    for (const auto& [number, channel] : _channels)
        status.push_back(channel->status());
    return status;
}

Bytes TelephonyService::handleRequest(std::int32_t id, ByteView body)
{
    const auto request = parsePropertyList(body);
    const std::string* clientPort = id == Protocol::CreateLogChannelId && request && request->dictionary()
        ? (*request->dictionary())[Protocol::CreateLogChannelKey].string()
        : nullptr;
    if (!clientPort || clientPort->empty())
        return answer(ChannelError::MalformedRequest);
    if (!_source.isReady())
        return answer(ChannelError::NotReady);
    if (_channels.size() >= MaxChannels)
        return answer(ChannelError::TooManyChannels);
    const unsigned number = ++_latestNumber;
    auto channel = LogChannel::open(_runLoop, _clock, _ports, _source, number, *clientPort, [this, number] {
        _channels.erase(number);
        reportChange();
    });
    if (!channel)
        return answer(ChannelError::NoSuchPort);
    const std::string name = channel->portName();
    _channels.emplace(number, std::move(channel));
    reportChange();
    return answer(ChannelError::None, name);
}

} // namespace spectrel
