#include "Records/Capture/CaptureOutput.h"

#include "Records/Capture/CaptureFormat.h"

#include <cerrno>
#include <fcntl.h>
#include <filesystem>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

/// Beside the file, so that it can be renamed; the number keeps two programs apart.
std::string hiddenName(const std::filesystem::path& path)
{
    return (path.parent_path() / ("." + path.filename().string() + "-" + std::to_string(::getpid()))).string();
}

/// Opens a file that is there and takes its packets away, but not its head. Less than 0 on failure.
int openEmptied(const std::string& path)
{
    const int file = ::open(path.c_str(), O_WRONLY | O_CLOEXEC);
    struct stat state { };
    if (file >= 0 && ::fstat(file, &state) == 0 && S_ISREG(state.st_mode) && state.st_size > off_t {CaptureHeaderSize}
        && ::ftruncate(file, CaptureHeaderSize) != 0) {
        ::close(file);
        return -1;
    }
    return file;
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

} // namespace

CaptureOutput::CaptureOutput(std::FILE* stream, std::string path, std::string hidden, IfThere ifThere)
    : _stream(stream)
    , _path(std::move(path))
    , _hidden(std::move(hidden))
    , _ifThere(ifThere)
{
}

CaptureOutput::CaptureOutput(CaptureOutput&& other) noexcept
    : _stream(other._stream)
    , _path(std::move(other._path))
    , _hidden(std::exchange(other._hidden, {}))
    , _ifThere(other._ifThere)
{
}

CaptureOutput::~CaptureOutput()
{
    if (!_hidden.empty())
        ::unlink(_hidden.c_str());
}

Result<CaptureOutput> CaptureOutput::open(const std::string& path, IfThere ifThere)
{
    std::string hidden;
    int file = -1;
    if (path == "-")
        file = ::dup(STDOUT_FILENO);
    else if (ifThere == IfThere::Overwrite)
        file = openEmptied(path);
    if (file < 0 && path != "-" && (ifThere == IfThere::Refuse || errno == ENOENT)) {
        hidden = hiddenName(path);
        file = ::open(hidden.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666);
    }
    std::FILE* const stream = file < 0 ? nullptr : ::fdopen(file, "wb");
    if (!stream)
        return Failure::ofSystem();
    return CaptureOutput(stream, path, std::move(hidden), ifThere);
}

Outcome CaptureOutput::publish()
{
    if (_hidden.empty())
        return Done();
    const bool named =
        _ifThere == IfThere::Overwrite ? ::rename(_hidden.c_str(), _path.c_str()) == 0 : renamedToFree(_hidden, _path);
    if (!named)
        return Failure::ofSystem();
    _hidden.clear();
    return Done();
}

} // namespace spectrel
