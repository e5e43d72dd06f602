#include "Records/RecordingFile.h"

#include <cerrno>
#include <sys/stat.h>

namespace spectrel {

Result<RecordingFile> RecordingFile::open(const std::string& path)
{
    RecordingFile file;
    file._file.reset(std::fopen(path.c_str(), "rbe"));
    struct stat status { };
    if (!file._file || ::fstat(::fileno(file.get()), &status) != 0)
        return Failure::ofSystem();
    if (S_ISDIR(status.st_mode))
        return Failure::ofSystem(EISDIR);
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

Result<Bytes> RecordingFile::readAll(std::size_t largest)
{
    constexpr std::size_t Step = 1 << 16;
    Bytes bytes;
    std::size_t length = 0;
    for (std::size_t count = Step; count == Step; length += count) {
        if (length > largest)
            return Failure {"larger than " + std::to_string(largest) + " bytes"};
        bytes.resize(length + Step);
        count = std::fread(bytes.data() + length, 1, Step, get());
    }
    if (std::ferror(get()))
        return Failure::ofSystem();
    bytes.resize(length);
    return bytes;
}

} // namespace spectrel
