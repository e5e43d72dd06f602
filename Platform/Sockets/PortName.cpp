#include "Platform/Sockets/PortName.h"

#include "Platform/SystemLog.h"

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {

namespace {

/// Whether the path still leads to the open file; another holder may have removed it between opening and locking.
bool isStillThere(int file, const std::string& path)
{
    struct stat opened = {};
    struct stat named = {};
    return ::fstat(file, &opened) == 0 && ::lstat(path.c_str(), &named) == 0 && opened.st_dev == named.st_dev
        && opened.st_ino == named.st_ino;
}

void logRefusal(SystemLog& log, std::string_view name, const char* reason)
{
    SPECTREL_LOG(log, Priority::Error, "Message port name \"%.*s\" refused: %s", static_cast<int>(name.size()),
        name.data(), reason);
}

} // namespace

std::optional<sockaddr_un> portAddress(const std::string& directory, std::string_view name, SystemLog& log)
{
    if (name.empty() || name.front() == '.' || name.find('/') != name.npos || name.find('\0') != name.npos) {
        logRefusal(log, name, "it must not be empty, start with a dot, or hold a slash or a zero byte");
        return std::nullopt;
    }
    const std::string path = directory + "/" + std::string(name);
    sockaddr_un address = {};
    if (path.size() >= sizeof address.sun_path) {
        logRefusal(log, name, "with its folder it is longer than 107 bytes");
        return std::nullopt;
    }
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, path.data(), path.size());
    return address;
}

std::optional<NameLock> NameLock::take(const std::string& directory, std::string_view name)
{
    const std::string path = directory + "/." + std::string(name) + ".lock";
    for (;;) {
        FileDescriptor file(::open(path.c_str(), O_CREAT | O_RDWR | O_CLOEXEC | O_NOFOLLOW, 0600));
        if (!file)
            return std::nullopt;
        if (::flock(file.number(), LOCK_EX | LOCK_NB) != 0) {
            if (errno == EINTR)
                continue;
            return std::nullopt;
        }
        if (isStillThere(file.number(), path))
            return NameLock(std::move(file), path);
    }
}

NameLock::~NameLock()
{
    if (!_file)
        return;
    ::unlink(_path.c_str());
    ::flock(_file.number(), LOCK_UN); // a forked child may still hold a copy of the descriptor
}

} // namespace spectrel
