#include "Records/Capture/CaptureOutput.h"

#include "Records/Capture/CaptureFormat.h"

#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

constexpr int MostHiddenNames = 100; // tried, where somebody has taken one

/// Beside the file, so that it can be renamed; the process's number keeps two programs apart.
std::string hiddenName(const std::filesystem::path& path, int attempt)
{
    const std::string behind = attempt == 0 ? std::string() : "-" + std::to_string(attempt);
    return (path.parent_path() / ("." + path.filename().string() + "-" + std::to_string(::getpid()) + behind)).string();
}

Result<int> makeHidden(const std::string& path, std::string& hidden)
{
    for (int attempt = 0;; ++attempt) {
        hidden = hiddenName(path, attempt);
        auto file = openOwnFile(hidden, IfThere::Refuse);
        if (file || file.failure().code != Failure::Code::Exists || attempt == MostHiddenNames)
            return file;
    }
}

bool isRegular(int file, struct stat& status)
{
    return ::fstat(file, &status) == 0 && S_ISREG(status.st_mode);
}

/// Takes the packets of a file away that was there, but not its head.
Outcome emptyBehindHead(int file)
{
    struct stat status { };
    if (!isRegular(file, status))
        return Done();
    if (::flock(file, LOCK_EX | LOCK_NB) != 0)
        return Failure {"another program is writing it", Failure::Code::Refused};
    if (status.st_size > off_t {CaptureHeaderSize} && ::ftruncate(file, CaptureHeaderSize) != 0)
        return Failure::ofSystem();
    return Done();
}

/// Whether the file got the name, which no other had.
bool renamedToFree(const std::string& from, const std::string& to)
{
    if (::renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE) == 0)
        return true;
    if (errno != EINVAL && errno != ENOSYS)
        return false;
    // A file system that cannot do it at once.
    if (::link(from.c_str(), to.c_str()) != 0)
        return false;
    ::unlink(from.c_str());
    return true;
}

bool isThere(const std::string& path)
{
    struct stat status { };
    return ::lstat(path.c_str(), &status) == 0;
}

} // namespace

CaptureOutput::CaptureOutput(int file, std::string path, std::string hidden)
    : _file(file)
    , _path(std::move(path))
    , _hidden(std::move(hidden))
{
}

CaptureOutput::CaptureOutput(CaptureOutput&& other) noexcept
    : _file(std::exchange(other._file, -1))
    , _length(other._length)
    , _path(std::move(other._path))
    , _hidden(std::exchange(other._hidden, {}))
{
}

CaptureOutput::~CaptureOutput()
{
    if (!_hidden.empty())
        ::unlink(_hidden.c_str());
    if (_file >= 0)
        ::close(_file);
}

Result<CaptureOutput> CaptureOutput::open(const std::string& path, IfThere ifThere)
{
    if (path == "-") {
        const int file = ::fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, 0);
        return file >= 0 ? Result<CaptureOutput>(CaptureOutput(file, path, {})) : Failure::ofSystem();
    }
    std::string hidden;
    const bool isNew = ifThere == IfThere::Refuse || !isThere(path);
    const auto opened = isNew ? makeHidden(path, hidden) : openOwnFile(path, ifThere);
    if (!opened)
        return opened.failure();
    CaptureOutput output(*opened, path, hidden);
    if (isNew)
        ::flock(output._file, LOCK_EX | LOCK_NB); // before anybody knows the name
    else if (const auto emptied = emptyBehindHead(output._file); !emptied)
        return emptied.failure();
    return output;
}

Outcome CaptureOutput::publish()
{
    if (_hidden.empty())
        return Done();
    if (!renamedToFree(_hidden, _path))
        return Failure::ofSystem();
    _hidden.clear();
    return Done();
}

Outcome CaptureOutput::append(ByteView bytes)
{
    for (ByteView rest = bytes; !rest.empty();) {
        const ssize_t written = ::write(_file, rest.data(), rest.size());
        if (written >= 0) {
            rest = rest.subspan(static_cast<std::size_t>(written));
        } else if (errno != EINTR) {
            const Failure failure = Failure::ofSystem();
            struct stat status { };
            if (rest.size() < bytes.size() && isRegular(_file, status)
                && (::ftruncate(_file, _length) != 0 || ::lseek(_file, _length, SEEK_SET) != _length))
                return Failure {failure.text + ", and the message that was cut cannot be taken away"};
            return failure;
        }
    }
    _length += static_cast<off_t>(bytes.size());
    return Done();
}

} // namespace spectrel
