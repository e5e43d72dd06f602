#include "Tests/Fakes/FakeMessagePorts.h"

#include <utility>

namespace spectrel {

struct FakeMessagePorts::Local final : LocalMessagePort {
    Local(std::string portName, MessageHandler messageHandler)
        : name_(std::move(portName))
        , handler(std::move(messageHandler))
    {
    }
    const std::string& name() const override
    {
        return name_;
    }
    void serve() override
    {
        isServed = true;
    }
    void setPaused(bool paused) override
    {
        isPaused = paused;
    }
    void setInvalidationHandler(InvalidationHandler newHandler) override
    {
        invalidation = std::move(newHandler);
    }
    void invalidate() override
    {
        if (!std::exchange(valid, false))
            return;
        if (const auto called = std::exchange(invalidation, {}))
            called();
    }
    bool isValid() const override
    {
        return valid;
    }

    std::string name_;
    MessageHandler handler;
    InvalidationHandler invalidation;
    bool isServed = false;
    bool isPaused = false;
    bool valid = true;
};

struct FakeMessagePorts::Remote final : RemoteMessagePort {
    Remote(FakeMessagePorts& owner, std::string portName)
        : ports(owner)
        , name_(std::move(portName))
    {
    }
    const std::string& name() const override
    {
        return name_;
    }
    SendStatus sendRequest(std::int32_t id, ByteView body, std::chrono::nanoseconds sendTimeout,
        std::chrono::nanoseconds receiveTimeout, ReplyMode replyMode, std::optional<Bytes>* reply) override
    {
        if (!valid)
            return SendStatus::Invalid;
        ports.sent.push_back({id, std::string(body.begin(), body.end()), sendTimeout, receiveTimeout, replyMode});
        if (!ports.answer)
            return SendStatus::Success;
        Answer given = ports.answer(Sent(ports.sent.back()));
        if (reply)
            *reply = std::move(given.reply);
        return given.status;
    }
    void setInvalidationHandler(InvalidationHandler newHandler) override
    {
        invalidation = std::move(newHandler);
    }
    void invalidate() override
    {
        if (!std::exchange(valid, false))
            return;
        if (const auto called = std::exchange(invalidation, {}))
            called();
    }
    bool isValid() const override
    {
        return valid;
    }
    void setWritableHandler(std::function<void()> newHandler) override
    {
        writable = std::move(newHandler);
    }

    FakeMessagePorts& ports;
    std::string name_;
    InvalidationHandler invalidation;
    std::function<void()> writable;
    bool valid = true;
};

MessagePorts::LocalResult FakeMessagePorts::createLocal(std::string_view name, LocalMessagePort::MessageHandler handler)
{
    if (refuseLocal)
        return {};
    auto& held = _locals[std::string(name)];
    if (auto existing = held.lock(); existing && existing->isValid())
        return {existing, true};
    auto port = std::make_shared<Local>(std::string(name), std::move(handler));
    held = port;
    return {port, existingLocal};
}

std::shared_ptr<RemoteMessagePort> FakeMessagePorts::createRemote(std::string_view name)
{
    if (refuseRemote)
        return nullptr;
    auto port = std::make_shared<Remote>(*this, std::string(name));
    _remotes.push_back(port);
    return port;
}

bool FakeMessagePorts::deliver(const std::string& name, std::int32_t id, ByteView body)
{
    const auto port = _locals[name].lock();
    if (!port || !port->isServed || port->isPaused || !port->isValid())
        return false;
    port->handler(id, body);
    return true;
}

std::optional<Bytes> FakeMessagePorts::request(const std::string& name, std::int32_t id, ByteView body)
{
    const auto port = _locals[name].lock();
    return port && port->isServed && port->isValid() ? port->handler(id, body) : std::nullopt;
}

void FakeMessagePorts::makeRoom()
{
    for (const auto& remote : _remotes) {
        if (const auto port = remote.lock(); port && port->writable)
            port->writable();
    }
}

void FakeMessagePorts::invalidateLocal(const std::string& name)
{
    if (const auto port = _locals[name].lock())
        port->invalidate();
}

void FakeMessagePorts::killPeers()
{
    for (const auto& remote : _remotes) {
        if (const auto port = remote.lock())
            port->invalidate();
    }
}

std::size_t FakeMessagePorts::localPorts() const
{
    std::size_t count = 0;
    for (const auto& [name, held] : _locals) {
        const auto port = held.lock();
        count += port && port->isValid() ? 1 : 0;
    }
    return count;
}

namespace {

struct FakeConnection final : TelephonyServerConnection {
    explicit FakeConnection(FakeTelephonyServer& owner)
        : server(owner)
    {
    }
    LogChannelResult RKServerConnectionNetworkMonitorCreateLogChannel(std::string_view localPortName) override
    {
        server.channelsFor.emplace_back(localPortName);
        return server.result;
    }
    FakeTelephonyServer& server;
};

} // namespace

std::unique_ptr<TelephonyServerConnection> FakeTelephonyServer::RKServerConnectionCreate(NotificationHandler handler)
{
    notification = std::move(handler);
    return isRunning ? std::make_unique<FakeConnection>(*this) : nullptr;
}

} // namespace spectrel
