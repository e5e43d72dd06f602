#include "Tests/Platform/RawPeer.h"

#include <cstring>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace spectrel::raw {

namespace {

sockaddr_un addressOf(const std::string& directory, std::string_view name)
{
    sockaddr_un address = {};
    address.sun_family = AF_UNIX;
    const std::string path = directory + "/" + std::string(name);
    std::strncpy(address.sun_path, path.c_str(), sizeof address.sun_path - 1);
    return address;
}

int withSendBuffer(int number)
{
    const int size = 212'992;
    ::setsockopt(number, SOL_SOCKET, SO_SNDBUF, &size, sizeof size);
    return number;
}

int makeSocket()
{
    return withSendBuffer(::socket(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0));
}

} // namespace

int connectTo(const std::string& directory, std::string_view name)
{
    const int number = makeSocket();
    const auto address = addressOf(directory, name);
    if (::connect(number, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0)
        return number;
    ::close(number);
    return -1;
}

int listenAt(const std::string& directory, std::string_view name)
{
    const int number = makeSocket();
    const auto address = addressOf(directory, name);
    if (::bind(number, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0 && ::listen(number, 8) == 0)
        return number;
    ::close(number);
    return -1;
}

int accept(int listening)
{
    return withSendBuffer(::accept4(listening, nullptr, nullptr, SOCK_CLOEXEC)); // it inherits none
}

std::string packet(std::uint8_t kind, std::int32_t id, std::uint32_t sequence, std::string_view body)
{
    std::string bytes {'\x53', static_cast<char>(kind), '\0', '\0'};
    for (const std::uint32_t number : {static_cast<std::uint32_t>(id), sequence}) {
        for (int shift = 0; shift < 32; shift += 8)
            bytes += static_cast<char>(number >> shift);
    }
    return bytes + std::string(body);
}

bool send(int socket, std::string_view bytes)
{
    return ::send(socket, bytes.data(), bytes.size(), MSG_NOSIGNAL) == static_cast<ssize_t>(bytes.size());
}

std::string receive(int socket)
{
    static char bytes[300'000];
    const ssize_t count = ::recv(socket, bytes, sizeof bytes, 0);
    return {bytes, count > 0 ? static_cast<std::size_t>(count) : 0};
}

} // namespace spectrel::raw
