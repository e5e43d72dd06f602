#include "Records/RecordingFile.h"

#include <cerrno>
#include <cstring>
#include <sys/stat.h>

namespace spectrel {

std::optional<RecordingFile> RecordingFile::open(const std::string& path, std::string& reason)
{
    RecordingFile file;
    file._file.reset(std::fopen(path.c_str(), "rbe"));
    struct stat status { };
    if (!file._file || ::fstat(::fileno(file.get()), &status) != 0) {
        reason = std::strerror(errno);
        return std::nullopt;
    }
    if (S_ISDIR(status.st_mode)) {
        reason = std::strerror(EISDIR);
        return std::nullopt;
    }
    return file;
}

Bytes RecordingFile::peek()
{
    Bytes bytes;
    for (int byte = 0; bytes.size() < 4 && (byte = std::getc(get())) != EOF;)
        bytes.push_back(static_cast<std::uint8_t>(byte));
    for (std::size_t i = bytes.size(); i > 0; --i)
        std::ungetc(bytes[i - 1], get()); // they still stand in the buffer, so that all of them go back
    return bytes;
}

std::optional<Bytes> RecordingFile::readAll(std::size_t largest, std::string& reason)
{
    constexpr std::size_t Step = 1 << 16;
    Bytes bytes;
    std::size_t length = 0;
    for (std::size_t count = Step; count == Step; length += count) {
        if (length > largest) {
            reason = "larger than " + std::to_string(largest) + " bytes";
            return std::nullopt;
        }
        bytes.resize(length + Step);
        count = std::fread(bytes.data() + length, 1, Step, get());
    }
    if (std::ferror(get())) {
        reason = std::strerror(errno);
        return std::nullopt;
    }
    bytes.resize(length);
    return bytes;
}

} // namespace spectrel
