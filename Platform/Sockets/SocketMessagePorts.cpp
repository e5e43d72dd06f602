#include "Platform/Sockets/SocketMessagePorts.h"

#include "Platform/Places.h"
#include "Platform/Sockets/SocketLocalPort.h"
#include "Platform/Sockets/SocketRemotePort.h"
#include "Platform/Sockets/Wire.h"
#include "Platform/SystemLog.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/socket.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

constexpr int Backlog = 64; // senders that wait to be accepted

FileDescriptor makeSocket()
{
    FileDescriptor socket(::socket(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    if (socket)
        ::setsockopt(socket.number(), SOL_SOCKET, SO_SNDBUF, &wire::SendBuffer, sizeof wire::SendBuffer);
    return socket;
}

/// A socket listening at the address. A file that is there is a dead process's: the caller holds the name's lock.
FileDescriptor listenAt(const sockaddr_un& address, SystemLog& log)
{
    FileDescriptor socket = makeSocket();
    ::unlink(address.sun_path);
    if (socket && ::bind(socket.number(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0
        && ::listen(socket.number(), Backlog) == 0)
        return socket;
    SPECTREL_LOG(log, Priority::Error, "Message port %s: %s", address.sun_path, std::strerror(errno));
    return {};
}

} // namespace

SocketMessagePorts::SocketMessagePorts(std::string directory, SystemLog& log)
    : _directory(std::move(directory))
    , _log(log)
{
}

Outcome SocketMessagePorts::prepareDirectory(const std::string& directory, std::string_view name)
{
    if (auto made = makePrivateDirectory(directory); !made)
        return made;
    if (!portAddress(directory, name, SystemLog::none()))
        return Failure {directory + ": with a port's name the path is longer than 107 bytes"};
    return Done();
}

MessagePorts::LocalResult SocketMessagePorts::createLocal(
    std::string_view name, LocalMessagePort::MessageHandler handler)
{
    std::erase_if(_locals, [](const auto& held) { return held.second.expired(); });
    if (const auto held = _locals.find(name); held != _locals.end()) {
        if (auto existing = held->second.lock(); existing && existing->isValid())
            return {std::move(existing), true};
    }
    const auto address = portAddress(_directory, name, _log);
    if (!address)
        return {};
    if (const auto made = makePrivateDirectory(_directory); !made) {
        SPECTREL_LOG(_log, Priority::Error, "Message ports: %s", made.failure().text.c_str());
        return {};
    }
    auto lock = NameLock::take(_directory, name);
    if (!lock)
        return {};
    const auto adopted = _adopted.extract(std::string(name));
    FileDescriptor socket = adopted ? std::move(adopted.mapped()) : listenAt(*address, _log);
    if (!socket)
        return {};
    // The file of a socket that was made elsewhere is not ours to remove.
    auto port = std::make_shared<SocketLocalPort>(std::string(name), adopted ? std::string() : address->sun_path,
        std::move(*lock), std::move(socket), std::move(handler), _log);
    _locals.insert_or_assign(std::string(name), port);
    return {std::move(port), false};
}

Outcome SocketMessagePorts::adopt(std::string_view name, FileDescriptor socket)
{
    const auto expected = portAddress(_directory, name, _log);
    sockaddr_un address = {};
    socklen_t length = sizeof address;
    if (!expected || ::getsockname(socket.number(), reinterpret_cast<sockaddr*>(&address), &length) != 0
        || std::strncmp(address.sun_path, expected->sun_path, sizeof address.sun_path) != 0)
        return Failure {"the socket passed on listens at " + std::string(address.sun_path) + ", clients look for it at "
            + (expected ? expected->sun_path : _directory)};
    ::fcntl(socket.number(), F_SETFL, ::fcntl(socket.number(), F_GETFL) | O_NONBLOCK);
    _adopted.insert_or_assign(std::string(name), std::move(socket));
    return Done();
}

std::shared_ptr<RemoteMessagePort> SocketMessagePorts::createRemote(std::string_view name)
{
    const auto address = portAddress(_directory, name, _log);
    if (!address)
        return nullptr;
    FileDescriptor socket = makeSocket();
    if (!socket || ::connect(socket.number(), reinterpret_cast<const sockaddr*>(&*address), sizeof *address) != 0
        || !wire::isPeerOfThisUser(socket.number()))
        return nullptr;
    return std::make_shared<SocketRemotePort>(std::string(name), std::move(socket), _log);
}

} // namespace spectrel
