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
#include <utility>

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

/// With what stands beside it. A file that somebody writes is locked, and stays; false then.
bool removeUnlessWritten(const fs::path& path)
{
    const int file = ::open(path.c_str(), O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC);
    if (file < 0)
        return false;
    const bool isRemoved = ::flock(file, LOCK_EX | LOCK_NB) == 0 && ::unlink(path.c_str()) == 0;
    if (isRemoved)
        removeBeside(path.string());
    ::close(file);
    return isRemoved;
}

} // namespace

RecordingFiles::RecordingFiles(RecordingFilesOptions options, const Clock& clock, RecordingOutput stream)
    : _options(std::move(options))
    , _clock(clock)
    , _stream(std::move(stream))
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
    const std::string place = folder();
    if (!_stream && ::access(place.empty() ? "." : place.c_str(), W_OK) != 0)
        return Failure::ofSystem().of(target);
    return checkTarget();
}

/// Whether the first file's name is free, or may be taken.
Outcome RecordingFiles::checkTarget() const
{
    struct stat status { };
    if (_stream || _isFolder || _options.overwrite || ::lstat(_options.target.c_str(), &status) != 0)
        return Done();
    if (S_ISREG(status.st_mode))
        return Failure {_options.target + ": is there already (--overwrite writes over it)", Failure::Code::Exists};
    return Done();
}

/// Behind the highest of the folder, and of those that were there.
Result<std::uint64_t> RecordingFiles::nextNumber() const
{
    const auto files = numberedFiles(_options.target);
    const std::uint64_t latest = files.empty() ? 0 : files.back().first;
    if (latest == std::numeric_limits<std::uint64_t>::max())
        return Failure {files.back().second.string() + ": has the highest number that there is; no file can follow it"};
    return std::max(latest, _number) + 1;
}

Outcome RecordingFiles::begin(Technology technology)
{
    return _writer ? Done() : beginNext(technology);
}

/// Without room for a further file the current one goes on.
Outcome RecordingFiles::write(Technology technology, ByteView message)
{
    const bool mustBegin = !_writer || technology != _technology;
    if (mustBegin || isFull(message.size())) {
        if (auto begun = beginNext(technology); !begun) {
            if (mustBegin || !_writer || begun.failure().code != Failure::Code::NoRoom)
                return begun;
        }
    }
    auto written = _writer->write(_clock.now(), message);
    while (!written && written.failure().code == Failure::Code::NoRoom && makeRoom())
        written = _writer->write(_clock.now(), message);
    if (!written)
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
    if (_writer && _stream)
        return Failure {spoken(_path) + ": one stream cannot tell of another technology; the recording ends"};
    if (auto flushed = flush(); !flushed)
        return flushed;
    _writer.reset(); // gives its lock up: it is one of those that may have to go
    _gaps.reset();
    if (_options.keep)
        removeBeyond(*_options.keep - 1);
    if (auto created = createNext(technology); !created)
        return created;
    ++_count;
    _technology = technology;
    _bytes = CaptureHeaderSize;
    _begun = _clock.steady();
    _isNamed = false;
    if (!_stream)
        _gaps = std::make_unique<GapFile>(_path);
    if (!_isFolder)
        _written.push_back(_path);
    return Done();
}

/// Two recorders never share a file, for a number that is taken is passed over.
Outcome RecordingFiles::createNext(Technology technology)
{
    const std::uint64_t before = _number;
    for (;;) {
        const auto number = _isFolder ? nextNumber() : Result<std::uint64_t>(_number + 1);
        if (!number)
            return number.failure();
        _number = *number;
        _path = numberedPath(technology);
        const bool isTarget = _path == _options.target;
        auto created = create(technology, isTarget);
        while (!created && created.failure().code == Failure::Code::NoRoom && makeRoom())
            created = create(technology, isTarget);
        if (created) {
            if (!_stream)
                removeBeside(_path); // of an earlier recording of this name
            _writer = *std::move(created);
            return Done();
        }
        if (isTarget || created.failure().code != Failure::Code::Exists) {
            _number = before;
            return created.failure().of(spoken(_path));
        }
    }
}

Result<std::unique_ptr<RecordingWriter>> RecordingFiles::create(Technology technology, bool isTarget) const
{
    if (_stream)
        return createRecordingOn(_stream, technology);
    return (isTarget && _options.overwrite ? createRecording : createNewRecording)(_path, technology);
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

/// Those that `keep` counts, the oldest first.
std::vector<std::string> RecordingFiles::keptFiles() const
{
    if (!_isFolder)
        return _written;
    std::vector<std::string> paths;
    for (const auto& [number, path] : numberedFiles(_options.target))
        paths.push_back(path.string());
    return paths;
}

/// What cannot be removed stays.
void RecordingFiles::removeBeyond(std::uint64_t count)
{
    const auto files = keptFiles();
    for (std::size_t i = 0; i + count < files.size(); ++i) {
        removeUnlessWritten(files[i]);
        std::erase(_written, files[i]);
    }
}

/// False when there is no file left that could go.
bool RecordingFiles::makeRoom()
{
    if (!_options.keep)
        return false;
    for (const std::string& each : keptFiles()) {
        if (each == _path && _writer)
            continue;
        std::erase(_written, each);
        if (removeUnlessWritten(each))
            return true;
    }
    return false;
}

std::string RecordingFiles::folder() const
{
    return _isFolder ? _options.target : fs::path(_options.target).parent_path().string();
}

Outcome RecordingFiles::flush()
{
    if (!_writer)
        return Done();
    auto flushed = _writer->flush();
    while (!flushed && flushed.failure().code == Failure::Code::NoRoom && makeRoom())
        flushed = _writer->flush();
    if (!flushed)
        return flushed.failure().of(spoken(_path));
    if (_stream)
        return Done();
    _disk->file(_writer->descriptor());
    if (!std::exchange(_isNamed, true))
        _disk->folder(folder());
    return _gaps->flush();
}

Outcome RecordingFiles::noteLost(std::uint64_t messages)
{
    return _gaps ? _gaps->add(_clock.now(), messages) : Done();
}

Outcome RecordingFiles::finish()
{
    auto flushed = flush();
    if (const auto synced = _disk->finish(); flushed && !synced)
        return synced.failure().of(spoken(_path));
    return flushed;
}

} // namespace spectrel
