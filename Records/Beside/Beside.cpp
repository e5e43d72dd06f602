#include "Records/Beside/Beside.h"

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <fcntl.h>
#include <memory>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {

namespace {

constexpr std::size_t LargestFile = 16 * 1024 * 1024;
constexpr std::size_t LongestLine = 64 * 1024;
constexpr double EndOfTime = 253'402'300'800; // the year 10000

struct Closing {
    void operator()(std::FILE* file) const
    {
        std::fclose(file);
    }
};
using File = std::unique_ptr<std::FILE, Closing>;

/// The file's content, as far as it is read; a failure of the system otherwise.
Result<std::string> contentOf(const std::string& path)
{
    const int descriptor = ::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
    struct stat status { };
    if (descriptor < 0 || ::fstat(descriptor, &status) != 0)
        return Failure::ofSystem();
    const File file(::fdopen(descriptor, "rb"));
    if (!S_ISREG(status.st_mode))
        return Failure {"is no file"};
    std::string content(LargestFile + 1, '\0');
    content.resize(std::fread(content.data(), 1, content.size(), file.get()));
    if (std::ferror(file.get()))
        return Failure::ofSystem();
    return content;
}

} // namespace

std::string pathBeside(const std::string& recording, std::string_view ending)
{
    constexpr std::string_view Capture = ".pcap";
    const bool isCapture = recording.ends_with(Capture);
    return recording.substr(0, recording.size() - (isCapture ? Capture.size() : 0)) + std::string(ending);
}

void removeBeside(const std::string& recording)
{
    for (const std::string_view ending : {MarksEnding, GapsEnding})
        ::unlink(pathBeside(recording, ending).c_str());
}

std::string readBeside(const std::string& path, const std::function<bool(const JsonObject&)>& read)
{
    const auto content = contentOf(path);
    if (!content)
        return content.failure().code == Failure::Code::Missing ? std::string() : content.failure().of(path).text;
    std::size_t number = 0;
    std::size_t firstWrong = 0;
    std::size_t wrong = 0;
    for (std::size_t start = 0; start < content->size();) {
        const std::size_t end = std::min(content->find('\n', start), content->size());
        const std::string line = content->substr(start, end - start);
        start = end + 1;
        ++number;
        if (line.find_first_not_of(" \t\r") == std::string::npos)
            continue;
        const auto object = line.size() <= LongestLine ? JsonObject::parse(line) : std::nullopt;
        if (!object || !read(*object))
            firstWrong = wrong++ == 0 ? number : firstWrong;
    }
    if (content->size() > LargestFile)
        return path + ": only the first 16 MiB were read";
    if (wrong == 0)
        return {};
    return path + ": line " + std::to_string(firstWrong) + " is not understood"
        + (wrong > 1 ? ", nor are " + std::to_string(wrong - 1) + " further ones" : "");
}

Outcome appendBeside(const std::string& path, std::string_view line)
{
    const int file = ::open(path.c_str(), O_RDWR | O_APPEND | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600);
    if (file < 0)
        return Failure::ofSystem().of(path);
    struct stat status { };
    if (::fstat(file, &status) != 0 || !S_ISREG(status.st_mode) || status.st_uid != ::geteuid()) {
        ::close(file);
        return Failure {path + ": is not a file of this user", Failure::Code::Refused};
    }
    std::string text(line);
    text += '\n';
    char last = '\n';
    if (status.st_size > 0 && ::pread(file, &last, 1, status.st_size - 1) == 1 && last != '\n')
        text.insert(0, "\n");
    const ::ssize_t written = ::write(file, text.data(), text.size());
    const int error = written < 0 ? errno : ENOSPC;
    ::close(file);
    if (written != static_cast<::ssize_t>(text.size()))
        return Failure::ofSystem(error).of(path);
    return Done();
}

std::optional<Moment> timeOf(const JsonObject& object)
{
    const auto seconds = object.number("time");
    if (!seconds || !(*seconds >= 0 && *seconds < EndOfTime))
        return std::nullopt;
    return Moment(std::chrono::microseconds(std::llround(*seconds * 1e6)));
}

} // namespace spectrel
