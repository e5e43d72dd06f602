#include "CommandLine/Commands/RecordingFiles.h"

#include "Records/Beside/Beside.h"
#include "Records/Capture/CaptureFormat.h"
#include "Values/OwnFile.h"

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <cstdio>
#include <fcntl.h>
#include <filesystem>
#include <limits>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

namespace spectrel {

namespace fs = std::filesystem;

namespace {

constexpr std::string_view FolderPrefix = "spectrel-";
constexpr std::string_view Extension = ".pcap";

/// The number in "spectrel-000001-lte.pcap"; 0 in any other name.
std::uint64_t numberOf(const std::string& name)
{
    std::uint64_t number = 0;
    if (!name.starts_with(FolderPrefix) || !name.ends_with(Extension))
        return 0;
    const char* const first = name.data() + FolderPrefix.size();
    const auto end = std::from_chars(first, name.data() + name.size(), number);
    return end.ec == std::errc() && *end.ptr == '-' ? number : 0;
}

std::string folderName(std::uint64_t number, Technology technology)
{
    char digits[32];
    std::snprintf(digits, sizeof digits, "%06llu", static_cast<unsigned long long>(number));
    return std::string(FolderPrefix) + digits + "-" + std::string(technologyName(technology)) + std::string(Extension);
}

/// The numbered files of a folder, by their numbers.
std::vector<std::pair<std::uint64_t, fs::path>> numberedFiles(const std::string& folder)
{
    std::vector<std::pair<std::uint64_t, fs::path>> files;
    std::error_code error;
    for (fs::directory_iterator each(folder, error); !error && each != fs::directory_iterator();
         each.increment(error)) {
        if (const auto number = numberOf(each->path().filename().string()); number > 0)
            files.emplace_back(number, each->path());
    }
    std::ranges::sort(files);
    return files;
}

/// With what stands beside it. A file that somebody writes is locked, and stays.
void removeUnlessWritten(const fs::path& path)
{
    const int file = ::open(path.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC);
    if (file < 0)
        return;
    if (::flock(file, LOCK_EX | LOCK_NB) == 0) {
        ::unlink(path.c_str());
        removeBeside(path.string());
    }
    ::close(file);
}

/// Whether there is something else than a file, such as a device.
bool isOther(const std::string& path)
{
    struct stat status { };
    return ::lstat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode);
}

} // namespace

RecordingFiles::RecordingFiles(RecordingFilesOptions options, const Clock& clock)
    : _options(std::move(options))
    , _clock(clock)
{
}

std::string RecordingFiles::spoken(const std::string& path)
{
    return path == "-" ? "standard output" : path;
}

Outcome RecordingFiles::prepare()
{
    const std::string& target = _options.target;
    std::error_code error;
    _isFolder = target.ends_with('/') || fs::is_directory(target, error);
    if (_isFolder) {
        if (auto made = makeOwnFolders(target); !made)
            return made;
    }
    const std::string folder = _isFolder ? target : fs::path(target).parent_path().string();
    if (target != "-" && ::access(folder.empty() ? "." : folder.c_str(), W_OK) != 0)
        return Failure::ofSystem().of(target);
    return checkTarget();
}

/// Whether the first file's name is free, or may be taken.
Outcome RecordingFiles::checkTarget() const
{
    struct stat status { };
    if (_options.target == "-" || _isFolder || ::lstat(_options.target.c_str(), &status) != 0)
        return Done();
    if (S_ISREG(status.st_mode) && !_options.overwrite)
        return Failure {_options.target + ": is there already (--overwrite writes over it)", Failure::Code::Exists};
    return Done();
}

/// Behind the highest of the folder.
Result<std::uint64_t> RecordingFiles::nextNumber() const
{
    const auto files = numberedFiles(_options.target);
    const std::uint64_t latest = files.empty() ? 0 : files.back().first;
    if (latest == std::numeric_limits<std::uint64_t>::max())
        return Failure {files.back().second.string() + ": has the highest number that there is; no file can follow it"};
    return latest + 1;
}

Outcome RecordingFiles::begin(Technology technology)
{
    return _writer ? Done() : beginNext(technology);
}

Outcome RecordingFiles::write(Technology technology, ByteView message)
{
    if (!_writer || technology != _technology || isFull(message.size())) {
        if (auto begun = beginNext(technology); !begun)
            return begun;
    }
    if (const auto written = _writer->write(_clock.now(), message); !written)
        return written.failure().of(spoken(_path));
    _bytes += PacketHeaderSize + message.size();
    return Done();
}

/// A file holds at least one message, however large.
bool RecordingFiles::isFull(std::size_t message) const
{
    if (_options.largestFile && _bytes > CaptureHeaderSize
        && _bytes + PacketHeaderSize + message > *_options.largestFile)
        return true;
    return _options.longestFile && _clock.steady() - _begun >= *_options.longestFile;
}

Outcome RecordingFiles::beginNext(Technology technology)
{
    if (_writer && _options.target == "-")
        return Failure {"standard output: one stream cannot tell of another technology; the recording ends"};
    if (auto flushed = flush(); !flushed)
        return flushed;
    if (auto created = createNext(technology); !created)
        return created;
    ++_count;
    _technology = technology;
    _bytes = CaptureHeaderSize;
    _begun = _clock.steady();
    removeOldest();
    return Done();
}

/// Two recorders never share a file, for a number that is taken is passed over.
Outcome RecordingFiles::createNext(Technology technology)
{
    for (;;) {
        const auto number = _isFolder ? nextNumber() : Result<std::uint64_t>(_number + 1);
        if (!number)
            return number.failure();
        _number = *number;
        _path = numberedPath(technology);
        const bool isTarget = _path == _options.target;
        const bool mayOverwrite = isTarget && (_path == "-" || _options.overwrite || isOther(_path));
        auto created = (mayOverwrite ? createRecording : createNewRecording)(_path, technology);
        if (created) {
            if (_path != "-" && !isOther(_path))
                removeBeside(_path); // of an earlier recording of this name
            _writer = *std::move(created);
            return Done();
        }
        if (isTarget || created.failure().code != Failure::Code::Exists) {
            _writer.reset();
            return created.failure().of(spoken(_path));
        }
    }
}

std::string RecordingFiles::numberedPath(Technology technology) const
{
    const fs::path target(_options.target);
    if (_isFolder)
        return (target / folderName(_number, technology)).string();
    if (_number == 1)
        return _options.target;
    const std::string name = target.stem().string() + "-" + std::to_string(_number) + target.extension().string();
    return (target.parent_path() / name).string();
}

/// What cannot be removed stays.
void RecordingFiles::removeOldest()
{
    if (!_options.keep)
        return;
    if (_isFolder) {
        const auto files = numberedFiles(_options.target);
        for (std::size_t i = 0; i + *_options.keep < files.size(); ++i)
            removeUnlessWritten(files[i].second);
        return;
    }
    _written.push_back(_path);
    if (_written.size() > *_options.keep) {
        removeUnlessWritten(_written.front());
        _written.erase(_written.begin());
    }
}

Outcome RecordingFiles::flush()
{
    const Outcome flushed = _writer ? _writer->flush() : Done();
    return flushed ? flushed : flushed.failure().of(spoken(_path));
}

} // namespace spectrel
