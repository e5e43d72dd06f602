#include "Telephony/LogChannel.h"

#include "Platform/TelephonyProtocol.h"
#include "Records/Frame.h"
#include "Telephony/ServiceLine.h"
#include "Values/Dictionary.h"
#include "Values/List.h"
#include "Values/PropertyList/PropertyList.h"

#include <utility>

namespace spectrel {

namespace {

namespace Protocol = TelephonyProtocol;

/// Behind the program's own name in the local port of each of this system's programs.
constexpr const char* EveryClientsSuffix = ".BasebandStateReport.LogChannel";

Bytes serialised(const Value& value)
{
    const std::string text = serialisePropertyList(value).value_or(std::string());
    return {text.begin(), text.end()};
}

Bytes errorAnswer(const char* text)
{
    return serialised(Dictionary::make({{Protocol::ErrorKey, text}}));
}

/// Adds a list of 16-bit codes; false when there is a value that is no such list.
bool addCodes(const Value& list, std::uint32_t offset, std::unordered_set<std::uint32_t>& codes)
{
    if (list.isAbsent())
        return true;
    if (!list.list())
        return false;
    for (const Value& element : list.list()->elements()) {
        const auto code = element.int32();
        if (!code || *code < 0 || *code > 0xFFFF)
            return false;
        codes.insert(static_cast<std::uint32_t>(*code) | offset);
    }
    return true;
}

} // namespace

std::optional<Subscription> Subscription::fromStartCommand(const Value& command)
{
    const auto& dictionary = command.dictionary();
    if (!dictionary || (*dictionary)[Protocol::SetStateKey] != Value(Protocol::StreamingState))
        return std::nullopt;
    Subscription subscription;
    const Value& ordinary = (*dictionary)[Protocol::OrdinaryCodesKey];
    const Value& extra = (*dictionary)[Protocol::ExtraCodesKey];
    subscription._wantsEverything = ordinary.isAbsent() && extra.isAbsent();
    if (!addCodes(ordinary, 0, subscription._codes) || !addCodes(extra, ExtraStream, subscription._codes))
        return std::nullopt;
    return subscription;
}

bool Subscription::wants(ByteView message) const
{
    const auto code = routedCode(message);
    return _wantsEverything || !code || _codes.contains(*code);
}

LogChannel::LogChannel(
    RunLoop& runLoop, const Clock& clock, LogSource& source, unsigned number, std::function<void()> onEnd)
    : _runLoop(runLoop)
    , _clock(clock)
    , _source(source)
    , _onEnd(std::move(onEnd))
{
    _status.name = "channel " + std::to_string(number);
}

std::unique_ptr<LogChannel> LogChannel::open(RunLoop& runLoop, const Clock& clock, MessagePorts& ports,
    LogSource& source, unsigned number, const std::string& clientPort, std::function<void()> onEnd)
{
    const std::string name = std::string(Protocol::ServicePort) + ".LogChannel." + std::to_string(number);
    std::unique_ptr<LogChannel> channel(new LogChannel(runLoop, clock, source, number, std::move(onEnd)));
    LogChannel* self = channel.get();
    channel->_client = ports.createRemote(clientPort);
    if (!channel->_client)
        return nullptr;
    channel->_requests =
        ports.createLocal(name, [self](std::int32_t id, ByteView body) { return self->handleRequest(id, body); }).port;
    if (!channel->_requests)
        return nullptr;
    channel->_requests->serve();
    channel->_client->setInvalidationHandler([self] { self->end(); });
    channel->_client->setWritableHandler([self] {
        if (self->_stream)
            self->_stream->resume();
    });
    channel->_status.client = clientPort.substr(0, clientPort.find(EveryClientsSuffix));
    printServiceLine(channel->_status.name + " opened for " + channel->_status.client);
    return channel;
}

LogChannel::~LogChannel()
{
    _stream.reset();
    if (_client) {
        _client->setInvalidationHandler({});
        _client->setWritableHandler({});
        _client->invalidate();
    }
    if (_requests)
        _requests->invalidate();
}

std::optional<Bytes> LogChannel::handleRequest(std::int32_t id, ByteView body)
{
    if (id != Protocol::LogChannelId) {
        printServiceLine(_status.name + ": a request of unknown id " + std::to_string(id));
        return errorAnswer("unknown message id");
    }
    const auto request = parsePropertyList(body);
    if (request && request->dictionary() && request->dictionary()->contains(Protocol::GetTechnologyKey)) {
        return serialised(Dictionary::make({{Protocol::GetTechnologyKey, technologyConstant(_source.technology())}}));
    }
    auto subscription = request ? Subscription::fromStartCommand(*request) : std::nullopt;
    if (!subscription) {
        printServiceLine(_status.name + ": a request that cannot be understood");
        return errorAnswer("the request cannot be understood");
    }
    startStreaming(std::move(*subscription));
    return std::nullopt;
}

void LogChannel::startStreaming(Subscription subscription)
{
    const std::string client = _status.client;
    _status = {_status.name, client, subscription.description(), true, false, _clock.steady(), 0, 0, 0, 0};
    printServiceLine(_status.name + ": streaming " + _status.wish + " to " + client);
    _stream.reset();
    _subscription = std::move(subscription);
    _stream = _source.start(*this);
}

bool LogChannel::deliver(ByteView message)
{
    if (!_subscription || !_subscription->wants(message)) {
        ++_status.notAskedFor;
        return true;
    }
    const SendStatus status = _client->sendRequest(Protocol::LogChannelId, message, std::chrono::nanoseconds::zero(),
        std::chrono::nanoseconds::zero(), ReplyMode::None, nullptr);
    if (status == SendStatus::TransportError)
        printServiceLine(_status.name + ": a message of " + std::to_string(message.size()) + " bytes cannot be sent");
    _status.isFull = status == SendStatus::SendTimeout;
    if (status == SendStatus::Success)
        ++_status.sent;
    return !_status.isFull;
}

ChannelStatus LogChannel::status() const
{
    ChannelStatus status = _status;
    if (_stream) {
        status.waiting = _stream->waiting();
        status.lost = _stream->lost();
    }
    return status;
}

/// The client is gone. Its end may be noticed in the middle of a delivery, so it is dealt with from the queue.
void LogChannel::end()
{
    _runLoop.async(_lifetime.guard([this] {
        printServiceLine(_status.name + " closed: " + _status.client + " is gone, after " + std::to_string(_status.sent)
            + " messages");
        const auto onEnd = std::move(_onEnd);
        onEnd(); // destroys this channel
    }));
}

} // namespace spectrel
