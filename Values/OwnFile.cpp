#include "Values/OwnFile.h"

#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {

namespace fs = std::filesystem;

namespace {

constexpr int Writing = O_WRONLY | O_CLOEXEC;
constexpr mode_t OwnersAlone = 0600;

/// The kernel's own folders, whose links lead to what the process holds.
bool isOfSystem(const std::string& path)
{
    return path.starts_with("/dev/") || path.starts_with("/proc/");
}

/// Whether what has been opened is this user's to overwrite.
Outcome checkOwn(const struct stat& status)
{
    const bool isOwn = status.st_uid == ::geteuid();
    if (S_ISCHR(status.st_mode) || S_ISBLK(status.st_mode) || (S_ISFIFO(status.st_mode) && isOwn))
        return Done();
    if (!isOwn)
        return Failure {"it belongs to somebody else", Failure::Code::Refused};
    if (S_ISREG(status.st_mode) && status.st_nlink != 1)
        return Failure {"it has a further name (a hard link)", Failure::Code::Refused};
    return S_ISREG(status.st_mode) ? Outcome(Done()) : Failure {"not a file", Failure::Code::Refused};
}

Outcome makePrivate(int file)
{
    struct stat status { };
    if (::fstat(file, &status) != 0)
        return Failure::ofSystem();
    if (auto own = checkOwn(status); !own)
        return own;
    if (S_ISREG(status.st_mode) && (status.st_mode & 07777) != OwnersAlone && ::fchmod(file, OwnersAlone) != 0)
        return Failure::ofSystem();
    return Done();
}

Failure whyNotOpened()
{
    if (errno == ELOOP)
        return Failure {"it is a link, and links are not followed", Failure::Code::Refused};
    return Failure::ofSystem();
}

/// A FIFO without a reader is waited for only where it is this user's.
Result<int> openThere(const std::string& path)
{
    struct stat status { };
    const bool isOwnFifo =
        ::lstat(path.c_str(), &status) == 0 && S_ISFIFO(status.st_mode) && status.st_uid == ::geteuid();
    const int file = ::open(path.c_str(), Writing | O_NOFOLLOW | (isOwnFifo ? 0 : O_NONBLOCK));
    if (file < 0)
        return whyNotOpened();
    if (const auto made = makePrivate(file); !made) {
        ::close(file);
        return made.failure();
    }
    ::fcntl(file, F_SETFL, ::fcntl(file, F_GETFL) & ~O_NONBLOCK);
    return file;
}

bool everybodyCanWrite(const fs::path& folder)
{
    struct stat status { };
    return ::stat(folder.c_str(), &status) == 0 && (status.st_mode & S_IWOTH) != 0;
}

Outcome makeOwnFolder(const fs::path& folder)
{
    if (::mkdir(folder.c_str(), 0700) == 0)
        return Done();
    const Failure failure = Failure::ofSystem();
    struct stat status { };
    if (::stat(folder.c_str(), &status) != 0)
        return failure.of(folder.string());
    if (!S_ISDIR(status.st_mode))
        return Failure::ofSystem(ENOTDIR).of(folder.string());
    if (!everybodyCanWrite(folder.parent_path()))
        return Done();
    if (::lstat(folder.c_str(), &status) != 0 || !S_ISDIR(status.st_mode)
        || (status.st_uid != ::geteuid() && status.st_uid != 0))
        return Failure {
            folder.string() + ": not a folder of this user, where everybody could have put it", Failure::Code::Refused};
    return Done();
}

} // namespace

Result<int> openOwnFile(const std::string& path, IfThere ifThere)
{
    if (ifThere == IfThere::Overwrite && isOfSystem(path)) {
        const int file = ::open(path.c_str(), Writing);
        return file >= 0 ? Result<int>(file) : Failure::ofSystem();
    }
    const int file = ::open(path.c_str(), Writing | O_CREAT | O_EXCL | O_NOFOLLOW, OwnersAlone);
    if (file >= 0)
        return file;
    return errno == EEXIST && ifThere == IfThere::Overwrite ? openThere(path) : whyNotOpened();
}

Outcome makeOwnFolders(const std::string& path)
{
    std::error_code error;
    const fs::path whole = fs::absolute(path, error);
    fs::path folder;
    for (const fs::path& part : whole) {
        folder /= part;
        if (part.empty() || folder == whole.root_path())
            continue;
        if (auto made = makeOwnFolder(folder); !made)
            return made;
    }
    return Done();
}

} // namespace spectrel
