#include "Platform/Sockets/SocketRemotePort.h"

#include "Platform/Sockets/Wire.h"
#include "Platform/SystemLog.h"

#include <QSocketNotifier>

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <poll.h>
#include <utility>

namespace spectrel {

namespace {

constexpr int LargestBatch = 64; // late replies thrown away before the run loop turns

/// A moment to wait until, for system calls that are interrupted and taken up again.
class Deadline {
public:
    explicit Deadline(std::chrono::nanoseconds timeout)
        : _end(SteadyClock::now() + std::clamp(timeout, std::chrono::nanoseconds(0), Longest))
    {
    }
    bool isOver() const
    {
        return SteadyClock::now() >= _end;
    }
    /// Waits for the events; false when the time is over. Asks at least once.
    bool waitFor(int socket, short events) const
    {
        for (;;) {
            const auto left = std::max(std::chrono::nanoseconds(0), _end - SteadyClock::now());
            const auto seconds = std::chrono::floor<std::chrono::seconds>(left);
            const timespec limit {static_cast<time_t>(seconds.count()), static_cast<long>((left - seconds).count())};
            pollfd polled {socket, events, 0};
            const int ready = ::ppoll(&polled, 1, &limit, nullptr);
            if (ready > 0)
                return true;
            if (ready == 0 || errno != EINTR)
                return false;
        }
    }

private:
    using SteadyClock = std::chrono::steady_clock;
    static constexpr std::chrono::nanoseconds Longest = std::chrono::hours(24);
    SteadyClock::time_point _end;
};

} // namespace

class SocketRemotePort::Core : public std::enable_shared_from_this<Core> {
public:
    Core(std::string name, FileDescriptor socket, SystemLog& log)
        : _log(log)
        , _name(std::move(name))
        , _socket(std::move(socket))
        , _readable(std::make_unique<QSocketNotifier>(_socket.number(), QSocketNotifier::Read))
        , _writable(std::make_unique<QSocketNotifier>(_socket.number(), QSocketNotifier::Write))
    {
        _writable->setEnabled(false);
        QObject::connect(_readable.get(), &QSocketNotifier::activated, [this] { discardReplies(); });
        QObject::connect(_writable.get(), &QSocketNotifier::activated, [this] { tellWritable(); });
    }

    SendStatus send(wire::Kind kind, std::int32_t id, ByteView body, std::chrono::nanoseconds timeout);
    SendStatus waitForReply(std::int32_t id, std::chrono::nanoseconds timeout, std::optional<Bytes>* reply);
    void close();
    void invalidate();
    bool isPeerThere() const;
    void setWritableHandler(std::function<void()> handler);

    const std::string& name() const
    {
        return _name;
    }
    void setInvalidationHandler(InvalidationHandler handler)
    {
        _invalidation = std::move(handler);
    }

private:
    void discardReplies();
    void tellWritable();
    void dropPeer();
    void waitForRoom();

    SystemLog& _log;
    std::string _name;
    FileDescriptor _socket;
    std::unique_ptr<QSocketNotifier> _readable; // also tells of the peer's death
    std::unique_ptr<QSocketNotifier> _writable; // enabled only after a send that timed out
    InvalidationHandler _invalidation;
    std::function<void()> _writableHandler;
    bool _wantsRoom = false; // a send has timed out since the handler was called last
    std::uint32_t _sequence = 0;
    wire::Buffer _buffer;
};

SendStatus SocketRemotePort::Core::send(
    wire::Kind kind, std::int32_t id, ByteView body, std::chrono::nanoseconds timeout)
{
    if (!_socket)
        return SendStatus::Invalid;
    if (body.empty() || body.size() > LargestMessage)
        return SendStatus::TransportError;
    const wire::Header header {kind, id, ++_sequence};
    auto outcome = wire::send(_socket.number(), header, body);
    if (outcome == wire::Outcome::WouldBlock && timeout > timeout.zero()) {
        const Deadline deadline(timeout);
        while (outcome == wire::Outcome::WouldBlock && deadline.waitFor(_socket.number(), POLLOUT))
            outcome = wire::send(_socket.number(), header, body);
    }
    switch (outcome) {
    case wire::Outcome::Done:
        return SendStatus::Success;
    case wire::Outcome::WouldBlock:
        waitForRoom();
        return SendStatus::SendTimeout;
    case wire::Outcome::Closed:
        return SendStatus::Invalid; // the run loop's next turn tells the invalidation handler
    case wire::Outcome::Failed:
        break;
    }
    return SendStatus::TransportError;
}

SendStatus SocketRemotePort::Core::waitForReply(
    std::int32_t id, std::chrono::nanoseconds timeout, std::optional<Bytes>* reply)
{
    const Deadline deadline(timeout);
    while (deadline.waitFor(_socket.number(), POLLIN)) {
        ByteView bytes;
        std::size_t length = 0;
        const auto outcome = wire::receive(_socket.number(), _buffer, bytes, length);
        if (outcome == wire::Outcome::Closed)
            return SendStatus::BecameInvalid;
        if (outcome == wire::Outcome::WouldBlock)
            continue;
        const auto packet = length <= wire::LargestPacket ? wire::decode(bytes) : std::nullopt;
        if (outcome == wire::Outcome::Failed || !packet || packet->header.kind != wire::Kind::Reply) {
            dropPeer();
            return SendStatus::TransportError;
        }
        if (packet->header.sequence != _sequence || packet->header.id != id) { // a late one, whose request timed out
            if (deadline.isOver())
                break;
            continue;
        }
        if (reply && !packet->body.empty())
            *reply = Bytes(packet->body.begin(), packet->body.end());
        return SendStatus::Success;
    }
    return SendStatus::ReceiveTimeout;
}

void SocketRemotePort::Core::close()
{
    _readable.reset();
    _writable.reset();
    _socket.close();
}

void SocketRemotePort::Core::invalidate()
{
    if (!_socket)
        return;
    close();
    if (const auto handler = std::exchange(_invalidation, {}))
        handler();
}

bool SocketRemotePort::Core::isPeerThere() const
{
    if (!_socket)
        return false;
    pollfd polled {_socket.number(), 0, 0};
    return ::poll(&polled, 1, 0) == 0;
}

void SocketRemotePort::Core::setWritableHandler(std::function<void()> handler)
{
    _writableHandler = std::move(handler);
    if (_writable)
        _writable->setEnabled(_wantsRoom && _writableHandler);
}

/// Outside of requests nothing but late replies arrives, and the peer's end.
void SocketRemotePort::Core::discardReplies()
{
    const auto self = shared_from_this();
    for (int taken = 0; taken < LargestBatch; ++taken) {
        ByteView bytes;
        std::size_t length = 0;
        const auto outcome = wire::receive(_socket.number(), _buffer, bytes, length);
        if (outcome == wire::Outcome::WouldBlock)
            return;
        if (outcome != wire::Outcome::Done)
            return invalidate();
        const auto packet = length <= wire::LargestPacket ? wire::decode(bytes) : std::nullopt;
        if (!packet || packet->header.kind != wire::Kind::Reply)
            return dropPeer();
    }
}

void SocketRemotePort::Core::tellWritable()
{
    const auto self = shared_from_this();
    _writable->setEnabled(false);
    _wantsRoom = false;
    if (const auto handler = _writableHandler) // a copy: it may be replaced while it runs
        handler();
}

void SocketRemotePort::Core::dropPeer()
{
    SPECTREL_LOG(
        _log, Priority::Error, "Message port %s: dropped its owner, which sent what is no reply", _name.c_str());
    invalidate();
}

void SocketRemotePort::Core::waitForRoom()
{
    _wantsRoom = true;
    if (_writableHandler)
        _writable->setEnabled(true);
}

SocketRemotePort::SocketRemotePort(std::string name, FileDescriptor socket, SystemLog& log)
    : _core(std::make_shared<Core>(std::move(name), std::move(socket), log))
{
}

SocketRemotePort::~SocketRemotePort()
{
    _core->close();
}

const std::string& SocketRemotePort::name() const
{
    return _core->name();
}

SendStatus SocketRemotePort::sendRequest(std::int32_t id, ByteView body, std::chrono::nanoseconds sendTimeout,
    std::chrono::nanoseconds receiveTimeout, ReplyMode replyMode, std::optional<Bytes>* reply)
{
    if (reply)
        reply->reset();
    const auto core = _core; // a handler may destroy this object
    const bool waits = replyMode == ReplyMode::Wait;
    const auto status = core->send(waits ? wire::Kind::Request : wire::Kind::OneWay, id, body, sendTimeout);
    return waits && status == SendStatus::Success ? core->waitForReply(id, receiveTimeout, reply) : status;
}

void SocketRemotePort::setInvalidationHandler(InvalidationHandler handler)
{
    _core->setInvalidationHandler(std::move(handler));
}

void SocketRemotePort::invalidate()
{
    const auto core = _core;
    core->invalidate();
}

bool SocketRemotePort::isValid() const
{
    return _core->isPeerThere();
}

void SocketRemotePort::setWritableHandler(std::function<void()> handler)
{
    _core->setWritableHandler(std::move(handler));
}

} // namespace spectrel
