#include "Platform/Sockets/PipeInput.h"

#include <QTimer>

#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

constexpr const char* StandardInput = "-";
constexpr int RestAfterDropping = 100; // milliseconds in which a dropped writer may notice

/// Without waiting for a writer.
FileDescriptor openPath(const std::string& path)
{
    return FileDescriptor(path == StandardInput ? ::fcntl(STDIN_FILENO, F_DUPFD_CLOEXEC, 3)
                                                : ::open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
}

/// Why a thing of that kind cannot be relayed; empty when it can.
std::string objectionTo(const std::string& path, int descriptor, const struct stat& status)
{
    if (S_ISDIR(status.st_mode))
        return std::strerror(EISDIR);
    if (path == StandardInput)
        return ::isatty(descriptor) ? "a terminal, not a stream of log messages" : "";
    if (S_ISREG(status.st_mode))
        return "a file, which --replay plays";
    return "";
}

} // namespace

std::unique_ptr<PipeInput> PipeInput::open(const std::string& path, std::string& reason)
{
    FileDescriptor descriptor = openPath(path);
    struct stat status { };
    if (!descriptor || ::fstat(descriptor.number(), &status) != 0) {
        // A socket cannot be opened.
        reason = errno == ENXIO ? "a socket; to listen on one name it unix:" + path : std::strerror(errno);
        return nullptr;
    }
    reason = objectionTo(path, descriptor.number(), status);
    if (!reason.empty())
        return nullptr;
    const bool isFifo = path != StandardInput && S_ISFIFO(status.st_mode);
    return std::unique_ptr<PipeInput>(new PipeInput(path, std::move(descriptor), isFifo));
}

PipeInput::PipeInput(std::string path, FileDescriptor descriptor, bool isFifo)
    : _path(std::move(path))
    , _name(_path == StandardInput ? "standard input" : _path)
    , _first(std::move(descriptor))
    , _isFifo(isFifo)
    , _feed([this](const std::string& reason) { end(reason); })
{
}

void PipeInput::start(Listener& listener)
{
    _listener = &listener;
    _feed.open(std::move(_first), listener, _isFifo ? WriterFeed::Coming::WithFirstBytes : WriterFeed::Coming::Told);
}

void PipeInput::end(const std::string& reason)
{
    const bool hadWriter = _feed.hasWriter();
    std::string told = reason;
    if (!openAnew(told))
        _feed.close();
    if (hadWriter || !told.empty())
        _listener->writerEnded(told);
}

/// A FIFO without a reader ends its writers, all of them; what they have written is gone.
void PipeInput::dropWriter()
{
    _feed.close();
    if (_isFifo) {
        QTimer::singleShot(RestAfterDropping, &_later, [this] {
            std::string reason;
            if (!openAnew(reason))
                _listener->writerEnded(reason);
        });
    }
}

/// A FIFO's old end stays open until the new one is: a writer that has come in between must not find it without reader.
/// A new end does not tell of the former writer's hanging up again and again.
bool PipeInput::openAnew(std::string& reason)
{
    if (!_isFifo)
        return false;
    FileDescriptor next = openPath(_path);
    if (next) {
        _feed.open(std::move(next), *_listener, WriterFeed::Coming::WithFirstBytes);
        return true;
    }
    reason = "the FIFO cannot be opened again: " + std::string(std::strerror(errno));
    _isFifo = false;
    return false;
}

} // namespace spectrel
