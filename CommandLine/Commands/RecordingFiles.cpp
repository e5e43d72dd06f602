#include "CommandLine/Commands/RecordingFiles.h"

#include "Records/Beside/Beside.h"
#include "Records/Capture/CaptureFormat.h"

#include <algorithm>
#include <cerrno>
#include <charconv>
#include <cstdio>
#include <filesystem>
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

/// With what stands beside it.
void removeRecording(const std::string& path)
{
    std::error_code error;
    fs::remove(path, error);
    removeBeside(path);
}

} // namespace

RecordingFiles::RecordingFiles(RecordingFilesOptions options)
    : _options(std::move(options))
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
        fs::create_directories(target, error);
        if (error)
            return Failure {error.message()}.of(target);
    }
    const std::string folder = _isFolder ? target : fs::path(target).parent_path().string();
    if (target != "-" && ::access(folder.empty() ? "." : folder.c_str(), W_OK) != 0)
        return Failure::ofSystem().of(target);
    return Done();
}

std::uint64_t RecordingFiles::latestNumber() const
{
    const auto files = numberedFiles(_options.target);
    return files.empty() ? 0 : files.back().first;
}

Outcome RecordingFiles::begin(Technology technology, Moment time)
{
    return _writer ? Done() : beginNext(technology, time);
}

Outcome RecordingFiles::write(Technology technology, Moment time, ByteView message)
{
    if (!_writer || technology != _technology || isFull(message.size(), time)) {
        if (auto begun = beginNext(technology, time); !begun)
            return begun;
    }
    if (const auto written = _writer->write(time, message); !written)
        return written.failure().of(spoken(_path));
    _bytes += PacketHeaderSize + message.size();
    return Done();
}

/// A file holds at least one message, however large.
bool RecordingFiles::isFull(std::size_t message, Moment time) const
{
    if (_options.largestFile && _bytes > CaptureHeaderSize
        && _bytes + PacketHeaderSize + message > *_options.largestFile)
        return true;
    return _options.longestFile && time - _begun >= *_options.longestFile;
}

Outcome RecordingFiles::beginNext(Technology technology, Moment time)
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
    _begun = time;
    removeOldest();
    return Done();
}

/// Two recorders never share a file, for a number that is taken is passed over.
Outcome RecordingFiles::createNext(Technology technology)
{
    if (_isFolder)
        _number = latestNumber();
    for (;;) {
        ++_number;
        _path = numberedPath(technology);
        const bool isTarget = _path == _options.target;
        auto created = (isTarget ? createRecording : createNewRecording)(_path, technology);
        if (created) {
            if (_path != "-")
                removeBeside(_path); // of an earlier recording of this name
            _writer = *std::move(created);
            return Done();
        }
        if (created.failure().code != Failure::Code::Exists) {
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
            removeRecording(files[i].second);
        return;
    }
    _written.push_back(_path);
    if (_written.size() > *_options.keep) {
        removeRecording(_written.front());
        _written.erase(_written.begin());
    }
}

Outcome RecordingFiles::flush()
{
    const Outcome flushed = _writer ? _writer->flush() : Done();
    return flushed ? flushed : flushed.failure().of(spoken(_path));
}

} // namespace spectrel
