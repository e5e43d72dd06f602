#include "Platform/Sockets/ServiceManager.h"

#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

constexpr int FirstDescriptor = 3; // where passed descriptors start

/// A variable, taken out of the environment.
std::string takeVariable(const char* name)
{
    const char* value = std::getenv(name);
    std::string taken = value ? value : "";
    ::unsetenv(name);
    return taken;
}

int option(int socket, int name)
{
    int value = 0;
    socklen_t length = sizeof value;
    return ::getsockopt(socket, SOL_SOCKET, name, &value, &length) == 0 ? value : 0;
}

} // namespace

ServiceManager::ServiceManager()
    : _address(takeVariable("NOTIFY_SOCKET"))
{
    const std::string process = takeVariable("LISTEN_PID");
    const std::string count = takeVariable("LISTEN_FDS");
    takeVariable("LISTEN_FDNAMES");
    if (process == std::to_string(::getpid()))
        _passedDescriptors = std::atoi(count.c_str());
    for (int number = 0; number < _passedDescriptors; ++number)
        ::fcntl(FirstDescriptor + number, F_SETFD, FD_CLOEXEC);
}

void ServiceManager::notify(const std::string& state) const
{
    sockaddr_un address = {};
    if (_address.empty() || _address.size() >= sizeof address.sun_path)
        return;
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, _address.data(), _address.size());
    if (_address.front() == '@')
        address.sun_path[0] = '\0';
    const auto length = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + _address.size());
    const FileDescriptor socket(::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    if (socket) {
        [[maybe_unused]] const auto sent = ::sendto(socket.number(), state.data(), state.size(),
            MSG_NOSIGNAL | MSG_DONTWAIT, reinterpret_cast<const sockaddr*>(&address), length);
    }
}

Result<FileDescriptor> ServiceManager::takeListeningSocket()
{
    const int count = std::exchange(_passedDescriptors, 0);
    if (count == 0)
        return FileDescriptor();
    FileDescriptor socket(FirstDescriptor);
    if (count > 1)
        return Failure {"the service manager passed " + std::to_string(count) + " sockets instead of one"};
    if (option(socket.number(), SO_TYPE) != SOCK_SEQPACKET || option(socket.number(), SO_ACCEPTCONN) == 0)
        return Failure {"the service manager passed something else than a listening socket of sequential packets"};
    return socket;
}

} // namespace spectrel
