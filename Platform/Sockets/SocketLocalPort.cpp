#include "Platform/Sockets/SocketLocalPort.h"

#include "Platform/Sockets/Wire.h"
#include "Platform/SystemLog.h"

#include <QSocketNotifier>
#include <QTimer>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <optional>
#include <sys/socket.h>
#include <unistd.h>
#include <utility>
#include <vector>

namespace spectrel {

namespace {

constexpr int AcceptPause = 100; // milliseconds without new senders when the process has no descriptor to spare

} // namespace

class SocketLocalPort::Core : public std::enable_shared_from_this<Core> {
public:
    Core(std::string name, std::string path, NameLock lock, FileDescriptor socket, MessageHandler handler,
        SystemLog& log)
        : _log(log)
        , _name(std::move(name))
        , _path(std::move(path))
        , _lock(std::move(lock))
        , _socket(std::move(socket))
        , _handler(std::move(handler))
    {
    }

    void serve();
    void setPaused(bool isPaused);
    void close();
    void invalidate();

    const std::string& name() const
    {
        return _name;
    }
    bool isOpen() const
    {
        return static_cast<bool>(_socket);
    }
    void setInvalidationHandler(InvalidationHandler handler)
    {
        _invalidation = std::move(handler);
    }

private:
    struct Connection {
        FileDescriptor socket;
        std::unique_ptr<QSocketNotifier> notifier;
    };

    void acceptSenders();
    bool acceptOne();
    void add(FileDescriptor socket);
    void receiveFrom(int socket);
    bool receiveOne(int socket);
    bool answer(int socket, const wire::Header& request, const std::optional<Bytes>& reply);
    void drop(int socket, const char* reason);

    SystemLog& _log;
    std::string _name;
    std::string _path;
    std::optional<NameLock> _lock;
    FileDescriptor _socket;
    MessageHandler _handler;
    InvalidationHandler _invalidation;
    std::unique_ptr<QSocketNotifier> _acceptNotifier;
    std::vector<Connection> _connections;
    bool _isPaused = false;
    bool _isFull = false; // a sender was turned away, and logged, since the last one ended
    wire::Buffer _buffer;
};

void SocketLocalPort::Core::serve()
{
    if (!isOpen() || _acceptNotifier)
        return;
    _acceptNotifier = std::make_unique<QSocketNotifier>(_socket.number(), QSocketNotifier::Read);
    QObject::connect(_acceptNotifier.get(), &QSocketNotifier::activated, [this] { acceptSenders(); });
}

void SocketLocalPort::Core::setPaused(bool isPaused)
{
    _isPaused = isPaused;
    for (const Connection& each : _connections)
        each.notifier->setEnabled(!isPaused);
}

void SocketLocalPort::Core::close()
{
    if (!isOpen())
        return;
    _acceptNotifier.reset();
    _connections.clear();
    if (!_path.empty())
        ::unlink(_path.c_str());
    _socket.close();
    _lock.reset(); // last: until here nobody else can bind the path
}

void SocketLocalPort::Core::invalidate()
{
    if (!isOpen())
        return;
    close();
    if (const auto handler = std::exchange(_invalidation, {}))
        handler();
}

void SocketLocalPort::Core::acceptSenders()
{
    for (int taken = 0; taken < LargestBatch && acceptOne(); ++taken) { }
}

bool SocketLocalPort::Core::acceptOne()
{
    FileDescriptor sender(::accept4(_socket.number(), nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK));
    if (sender) {
        add(std::move(sender));
        return true;
    }
    if (errno == EINTR || errno == ECONNABORTED)
        return true;
    if (errno != EAGAIN && errno != EWOULDBLOCK) {
        // Out of descriptors or memory: the waiting sender would wake the loop without end.
        SPECTREL_LOG(
            _log, Priority::Error, "Message port %s: cannot accept a sender: %s", _name.c_str(), std::strerror(errno));
        _acceptNotifier->setEnabled(false);
        QTimer::singleShot(AcceptPause, _acceptNotifier.get(), [this] { _acceptNotifier->setEnabled(true); });
    }
    return false;
}

void SocketLocalPort::Core::add(FileDescriptor socket)
{
    if (!wire::isPeerOfThisUser(socket.number())) {
        SPECTREL_LOG(_log, Priority::Error, "Message port %s: a sender of another user was turned away", _name.c_str());
        return;
    }
    if (_connections.size() >= MostConnections) {
        if (!std::exchange(_isFull, true)) {
            SPECTREL_LOG(_log, Priority::Error, "Message port %s: more than %zu senders; further ones are turned away",
                _name.c_str(), MostConnections);
        }
        return;
    }
    const int number = socket.number();
    ::setsockopt(number, SOL_SOCKET, SO_SNDBUF, &wire::SendBuffer, sizeof wire::SendBuffer);
    auto notifier = std::make_unique<QSocketNotifier>(number, QSocketNotifier::Read);
    notifier->setEnabled(!_isPaused);
    QObject::connect(notifier.get(), &QSocketNotifier::activated, [this, number] { receiveFrom(number); });
    _connections.push_back({std::move(socket), std::move(notifier)});
}

void SocketLocalPort::Core::receiveFrom(int socket)
{
    const auto self = shared_from_this(); // the handler may end the port
    for (int taken = 0; taken < LargestBatch && isOpen() && !_isPaused && receiveOne(socket); ++taken) { }
}

/// True while there may be more to take from a connection that still stands.
bool SocketLocalPort::Core::receiveOne(int socket)
{
    ByteView bytes;
    std::size_t length = 0;
    switch (wire::receive(socket, _buffer, bytes, length)) {
    case wire::Outcome::WouldBlock:
        return false;
    case wire::Outcome::Closed:
        drop(socket, nullptr);
        return false;
    case wire::Outcome::Failed:
        drop(socket, "cannot be read");
        return false;
    case wire::Outcome::Done:
        break;
    }
    const auto packet = length <= wire::LargestPacket ? wire::decode(bytes) : std::nullopt;
    if (!packet || packet->header.kind == wire::Kind::Reply) {
        drop(socket, "sent what is no message");
        return false;
    }
    const auto reply = _handler(packet->header.id, packet->body);
    if (!isOpen())
        return false;
    return packet->header.kind == wire::Kind::OneWay || answer(socket, packet->header, reply);
}

bool SocketLocalPort::Core::answer(int socket, const wire::Header& request, const std::optional<Bytes>& reply)
{
    ByteView body;
    if (reply && reply->size() <= LargestMessage)
        body = *reply;
    else if (reply)
        SPECTREL_LOG(_log, Priority::Error, "Message port %s: an answer of %zu bytes is too large", _name.c_str(),
            reply->size());
    const wire::Header header {wire::Kind::Reply, request.id, request.sequence};
    if (wire::send(socket, header, body) == wire::Outcome::Done)
        return true;
    drop(socket, "does not take its answer");
    return false;
}

void SocketLocalPort::Core::drop(int socket, const char* reason)
{
    if (reason)
        SPECTREL_LOG(_log, Priority::Error, "Message port %s: dropped a sender that %s", _name.c_str(), reason);
    std::erase_if(_connections, [socket](const Connection& each) { return each.socket.number() == socket; });
    _isFull = false;
}

SocketLocalPort::SocketLocalPort(
    std::string name, std::string path, NameLock lock, FileDescriptor socket, MessageHandler handler, SystemLog& log)
    : _core(std::make_shared<Core>(
        std::move(name), std::move(path), std::move(lock), std::move(socket), std::move(handler), log))
{
}

SocketLocalPort::~SocketLocalPort()
{
    _core->close();
}

const std::string& SocketLocalPort::name() const
{
    return _core->name();
}

void SocketLocalPort::serve()
{
    _core->serve();
}

void SocketLocalPort::setPaused(bool isPaused)
{
    _core->setPaused(isPaused);
}

void SocketLocalPort::setInvalidationHandler(InvalidationHandler handler)
{
    _core->setInvalidationHandler(std::move(handler));
}

void SocketLocalPort::invalidate()
{
    const auto core = _core; // the handler may destroy this object
    core->invalidate();
}

bool SocketLocalPort::isValid() const
{
    return _core->isOpen();
}

} // namespace spectrel
