#pragma once

#include "Platform/Sockets/FileDescriptor.h"
#include "Platform/SystemLog.h"

#include <optional>
#include <string>
#include <string_view>
#include <sys/un.h>
#include <utility>

namespace spectrel {

/// The socket address of a port in the folder. None, logged with the reason, for a name that cannot be one: empty,
/// starting with ".", holding "/" or a zero byte, or too long for a socket's path together with the folder (107 bytes).
std::optional<sockaddr_un> portAddress(const std::string& directory, std::string_view name, SystemLog& log);

/// The right to a port's name: a lock on the file ".NAME.lock" in the folder, which ends with the process at the
/// latest.
class NameLock {
public:
    /// None when another process, or another object of this one, holds the name.
    static std::optional<NameLock> take(const std::string& directory, std::string_view name);

    NameLock(NameLock&&) = default;
    NameLock& operator=(NameLock&&) = delete;
    /// Removes the lock file and gives the name free.
    ~NameLock();

private:
    NameLock(FileDescriptor file, std::string path)
        : _file(std::move(file))
        , _path(std::move(path))
    {
    }

    FileDescriptor _file;
    std::string _path;
};

} // namespace spectrel
