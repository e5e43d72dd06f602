#include "Platform/Sockets/ListeningInput.h"

#include "Platform/Sockets/Wire.h"

#include <QSocketNotifier>
#include <QTimer>

#include <array>
#include <cerrno>
#include <cstring>
#include <netdb.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

constexpr int Backlog = 8; // writers that wait for the current one's end
constexpr int AcceptPause = 100; // milliseconds without new writers when the process has no descriptor to spare
constexpr const char* ThisMachine = "127.0.0.1";

/// Removes a socket that nobody listens on any more. Fails when something else is there.
Outcome makeWay(const sockaddr_un& address)
{
    struct stat status { };
    if (::lstat(address.sun_path, &status) != 0)
        return Done();
    if (!S_ISSOCK(status.st_mode))
        return Failure {"something else is there already", Failure::Code::Exists};
    const FileDescriptor probe(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    const bool isServed = ::connect(probe.number(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0
        || errno != ECONNREFUSED;
    if (isServed)
        return Failure {"another program listens there", Failure::Code::Exists};
    ::unlink(address.sun_path);
    return Done();
}

Result<FileDescriptor> listenAtPath(const std::string& path)
{
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    if (path.empty() || path.size() >= sizeof address.sun_path)
        return Failure {"a socket's path has 1 to 107 bytes"};
    std::memcpy(address.sun_path, path.data(), path.size());
    if (const auto way = makeWay(address); !way)
        return way.failure();
    FileDescriptor socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    const mode_t before = ::umask(0177); // other users do not even get to connect
    const bool isBound = socket && ::bind(socket.number(), reinterpret_cast<sockaddr*>(&address), sizeof address) == 0
        && ::listen(socket.number(), Backlog) == 0;
    ::umask(before);
    if (!isBound)
        return Failure::ofSystem();
    return socket;
}

struct HostAndPort {
    std::string host = ThisMachine;
    std::string port;
};

HostAndPort splitAddress(const std::string& address)
{
    const std::size_t colon = address.rfind(':');
    if (colon == std::string::npos)
        return {ThisMachine, address};
    std::string host = address.substr(0, colon);
    if (host.size() > 2 && host.front() == '[' && host.back() == ']')
        host = host.substr(1, host.size() - 2);
    return {host.empty() ? ThisMachine : host, address.substr(colon + 1)};
}

Result<FileDescriptor> listenAtAddress(const addrinfo& address)
{
    FileDescriptor socket(::socket(address.ai_family, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    const int yes = 1;
    if (!socket || ::setsockopt(socket.number(), SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes) != 0
        || ::bind(socket.number(), address.ai_addr, address.ai_addrlen) != 0 || ::listen(socket.number(), Backlog) != 0)
        return Failure::ofSystem();
    return socket;
}

Result<FileDescriptor> listenAtHost(const HostAndPort& place)
{
    if (place.port.empty() || place.port.find_first_not_of("0123456789") != std::string::npos || place.port.size() > 5
        || std::stoi(place.port) > 65535)
        return Failure {"a port is a number from 0 to 65535, as in tcp:127.0.0.1:4000"};
    addrinfo hints = {};
    hints.ai_socktype = SOCK_STREAM;
    hints.ai_flags = AI_PASSIVE | AI_NUMERICSERV;
    addrinfo* found = nullptr;
    if (const int error = ::getaddrinfo(place.host.c_str(), place.port.c_str(), &hints, &found); error != 0)
        return Failure {::gai_strerror(error)};
    const std::unique_ptr<addrinfo, decltype(&::freeaddrinfo)> owned(found, &::freeaddrinfo);
    return listenAtAddress(*found);
}

/// "127.0.0.1:4000", with the port that the system chose.
std::string addressOf(const FileDescriptor& socket)
{
    sockaddr_storage address = {};
    socklen_t length = sizeof address;
    std::array<char, NI_MAXHOST> host {};
    std::array<char, NI_MAXSERV> port {};
    if (::getsockname(socket.number(), reinterpret_cast<sockaddr*>(&address), &length) != 0
        || ::getnameinfo(reinterpret_cast<sockaddr*>(&address), length, host.data(), host.size(), port.data(),
               port.size(), NI_NUMERICHOST | NI_NUMERICSERV)
            != 0)
        return "?";
    const std::string name(host.data());
    return (name.find(':') == std::string::npos ? name : "[" + name + "]") + ":" + port.data();
}

/// A writer on another machine that vanishes without a word is noticed within two minutes.
void watchForVanishing(const FileDescriptor& socket)
{
    const int yes = 1;
    const int idle = 60;
    const int interval = 15;
    const int probes = 4;
    ::setsockopt(socket.number(), SOL_SOCKET, SO_KEEPALIVE, &yes, sizeof yes);
    ::setsockopt(socket.number(), IPPROTO_TCP, TCP_KEEPIDLE, &idle, sizeof idle);
    ::setsockopt(socket.number(), IPPROTO_TCP, TCP_KEEPINTVL, &interval, sizeof interval);
    ::setsockopt(socket.number(), IPPROTO_TCP, TCP_KEEPCNT, &probes, sizeof probes);
}

} // namespace

Result<std::unique_ptr<StreamInput>> ListeningInput::openUnix(const std::string& path)
{
    auto socket = listenAtPath(path);
    if (!socket)
        return socket.failure();
    return std::unique_ptr<StreamInput>(new ListeningInput("unix:" + path, path, *std::move(socket)));
}

Result<std::unique_ptr<StreamInput>> ListeningInput::openTCP(const std::string& address)
{
    auto socket = listenAtHost(splitAddress(address));
    if (!socket)
        return socket.failure();
    std::string name = "tcp:" + addressOf(*socket);
    return std::unique_ptr<StreamInput>(new ListeningInput(std::move(name), "", *std::move(socket)));
}

ListeningInput::ListeningInput(std::string name, std::string path, FileDescriptor socket)
    : _name(std::move(name))
    , _path(std::move(path))
    , _socket(std::move(socket))
    , _feed([this](const std::string& reason) { end(reason); })
{
}

ListeningInput::~ListeningInput()
{
    if (!_path.empty())
        ::unlink(_path.c_str());
}

void ListeningInput::start(Listener& listener)
{
    _listener = &listener;
    _notifier = std::make_unique<QSocketNotifier>(_socket.number(), QSocketNotifier::Read);
    QObject::connect(_notifier.get(), &QSocketNotifier::activated, [this] { acceptWriter(); });
}

void ListeningInput::acceptWriter()
{
    FileDescriptor writer(::accept4(_socket.number(), nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK));
    if (!writer) {
        if (errno == EMFILE || errno == ENFILE || errno == ENOMEM || errno == ENOBUFS) {
            _notifier->setEnabled(false);
            QTimer::singleShot(AcceptPause, _notifier.get(), [this] { listenIfFree(); });
        }
        return;
    }
    if (_path.empty()) {
        watchForVanishing(writer);
    } else if (!wire::isPeerOfThisUser(writer.number())) {
        return; // a writer of another user is turned away
    }
    _feed.open(std::move(writer), *_listener, WriterFeed::Coming::Told);
    listenIfFree();
}

void ListeningInput::end(const std::string& reason)
{
    dropWriter();
    _listener->writerEnded(reason);
}

void ListeningInput::dropWriter()
{
    _feed.close();
    listenIfFree();
}

void ListeningInput::setPaused(bool isPaused)
{
    _isPaused = isPaused;
    _feed.setPaused(isPaused);
    listenIfFree();
}

void ListeningInput::listenIfFree()
{
    if (_notifier)
        _notifier->setEnabled(!_isPaused && !_feed.isOpen());
}

} // namespace spectrel
