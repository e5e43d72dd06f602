#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {

namespace {

bool failed(std::string& reason)
{
    reason = std::strerror(errno);
    return false;
}

bool writeAll(int file, std::string_view text, std::string& reason)
{
    while (!text.empty()) {
        const ssize_t written = ::write(file, text.data(), text.size());
        if (written < 0 && errno == EINTR)
            continue;
        if (written < 0)
            return failed(reason);
        text.remove_prefix(static_cast<std::size_t>(written));
    }
    return true;
}

/// A file that was there keeps its old mode when it is opened; devices and pipes are left alone.
bool makePrivate(int file, std::string& reason)
{
    struct stat status { };
    if (::fstat(file, &status) != 0)
        return failed(reason);
    return !S_ISREG(status.st_mode) || ::fchmod(file, 0600) == 0 || failed(reason);
}

bool isWantOfRoom(int error)
{
    return error == ENOSPC || error == EDQUOT || error == EFBIG;
}

/// Gives a regular file its new size before the first byte is overwritten: where the disk is full, the file stays as it
/// was. File systems that cannot reserve tell at the write.
bool reserve(int file, std::size_t size, std::string& reason)
{
    struct stat status { };
    if (::fstat(file, &status) != 0)
        return failed(reason);
    if (!S_ISREG(status.st_mode))
        return true;
    if (::fallocate(file, 0, 0, static_cast<off_t>(size)) != 0 && isWantOfRoom(errno)) {
        failed(reason);
        [[maybe_unused]] const int shortened = ::ftruncate(file, status.st_size);
        return false;
    }
    return ::ftruncate(file, static_cast<off_t>(size)) == 0 || failed(reason);
}

/// The file's bytes; none when it cannot be read or is larger than a list may be.
std::optional<Bytes> readAll(int file)
{
    constexpr std::size_t Step = 1 << 16;
    Bytes bytes;
    for (std::size_t length = 0;;) {
        bytes.resize(std::max(length + Step, std::min(bytes.capacity(), 2 * length)));
        const ssize_t count = ::read(file, bytes.data() + length, bytes.size() - length);
        if (count < 0 && errno == EINTR)
            continue;
        length += count > 0 ? static_cast<std::size_t>(count) : 0;
        if (count < 0 || length > PropertyListLimits::SerialisedBytes)
            return std::nullopt;
        if (count == 0) {
            bytes.resize(length);
            return bytes;
        }
    }
}

} // namespace

bool writePropertyListToFile(const Value& value, const std::string& path, std::string& reason)
{
    const auto text = serialisePropertyList(value);
    if (!text) {
        reason = "the value cannot be written as a property list";
        return false;
    }
    int file = ::open(path.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600);
    const bool isNew = file >= 0;
    if (!isNew)
        file = ::open(path.c_str(), O_WRONLY | O_CREAT | O_CLOEXEC, 0600);
    if (file < 0)
        return failed(reason);
    const bool written =
        makePrivate(file, reason) && reserve(file, text->size(), reason) && writeAll(file, *text, reason);
    const bool closed = ::close(file) == 0 || (written && failed(reason)); // some file systems tell only now
    if (isNew && !(written && closed))
        ::unlink(path.c_str()); // half a list is of no use to anybody
    return written && closed;
}

std::optional<Value> readPropertyListFile(const std::string& path)
{
    const int file = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (file < 0)
        return std::nullopt;
    const auto bytes = readAll(file);
    ::close(file);
    return bytes ? parsePropertyList(*bytes) : std::nullopt;
}

} // namespace spectrel
