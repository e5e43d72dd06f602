#include "Values/OwnFile.h"
#include "Values/PropertyList/PropertyList.h"

#include <algorithm>
#include <cerrno>
#include <fcntl.h>
#include <string_view>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {

namespace {

Outcome doneIf(bool isDone)
{
    return isDone ? Outcome(Done()) : Failure::ofSystem();
}

Outcome writeAll(int file, std::string_view text)
{
    while (!text.empty()) {
        const ssize_t written = ::write(file, text.data(), text.size());
        if (written < 0 && errno == EINTR)
            continue;
        if (written < 0)
            return Failure::ofSystem();
        text.remove_prefix(static_cast<std::size_t>(written));
    }
    return Done();
}

/// Gives a regular file its new size before the first byte is overwritten: where the disk is full, the file stays as it
/// was. File systems that cannot reserve tell at the write.
Outcome reserve(int file, std::size_t size)
{
    struct stat status { };
    if (::fstat(file, &status) != 0)
        return Failure::ofSystem();
    if (!S_ISREG(status.st_mode))
        return Done();
    if (::fallocate(file, 0, 0, static_cast<off_t>(size)) != 0) {
        Failure failure = Failure::ofSystem();
        if (failure.code == Failure::Code::NoRoom) {
            [[maybe_unused]] const int shortened = ::ftruncate(file, status.st_size);
            return failure;
        }
    }
    return doneIf(::ftruncate(file, static_cast<off_t>(size)) == 0);
}

Outcome fill(int file, std::string_view text)
{
    if (auto outcome = reserve(file, text.size()); !outcome)
        return outcome;
    return writeAll(file, text);
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

Outcome writePropertyListToFile(const Value& value, const std::string& path)
{
    const auto text = serialisePropertyList(value);
    if (!text)
        return Failure {"the value cannot be written as a property list"};
    auto opened = openOwnFile(path, IfThere::Refuse);
    const bool isNew = bool(opened);
    if (!isNew && opened.failure().code == Failure::Code::Exists)
        opened = openOwnFile(path, IfThere::Overwrite);
    if (!opened)
        return opened.failure();
    const int file = *opened;
    Outcome outcome = fill(file, *text);
    if (::close(file) != 0 && outcome) // some file systems tell only now
        outcome = Failure::ofSystem();
    if (isNew && !outcome)
        ::unlink(path.c_str()); // half a list is of no use to anybody
    return outcome;
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
