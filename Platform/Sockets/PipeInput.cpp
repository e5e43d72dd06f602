#include "Platform/Sockets/PipeInput.h"

#include <QTimer>

#include <cerrno>
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

/// Whether a thing of that kind can be relayed.
Outcome checkKind(const std::string& path, int descriptor, const struct stat& status)
{
    if (S_ISDIR(status.st_mode))
        return Failure::ofSystem(EISDIR);
    if (path == StandardInput && ::isatty(descriptor))
        return Failure {"a terminal, not a stream of log messages", Failure::Code::Refused};
    if (path != StandardInput && S_ISREG(status.st_mode))
        return Failure {"a file, which --replay plays", Failure::Code::Refused};
    return Done();
}

} // namespace

Result<std::unique_ptr<StreamInput>> PipeInput::open(const std::string& path)
{
    FileDescriptor descriptor = openPath(path);
    struct stat status { };
    if (!descriptor || ::fstat(descriptor.number(), &status) != 0) {
        if (errno == ENXIO) // a socket cannot be opened
            return Failure {"a socket; to listen on one name it unix:" + path, Failure::Code::Refused};
        return Failure::ofSystem();
    }
    if (const auto kind = checkKind(path, descriptor.number(), status); !kind)
        return kind.failure();
    const bool isFifo = path != StandardInput && S_ISFIFO(status.st_mode);
    return std::unique_ptr<StreamInput>(new PipeInput(path, std::move(descriptor), isFifo));
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
    if (!_isFifo) {
        _feed.close();
    } else if (const auto opened = openAnew(); !opened) {
        told = opened.failure().text;
        _feed.close();
    }
    if (hadWriter || !told.empty())
        _listener->writerEnded(told);
}

/// A FIFO without a reader ends its writers, all of them; what they have written is gone.
void PipeInput::dropWriter()
{
    _feed.close();
    if (_isFifo) {
        QTimer::singleShot(RestAfterDropping, &_later, [this] {
            if (!_isFifo)
                return; // has failed to open, and said so
            if (const auto opened = openAnew(); !opened)
                _listener->writerEnded(opened.failure().text);
        });
    }
}

/// A FIFO's old end stays open until the new one is: a writer that has come in between must not find it without reader.
/// A new end does not tell of the former writer's hanging up again and again.
Outcome PipeInput::openAnew()
{
    FileDescriptor next = openPath(_path);
    if (!next) {
        _isFifo = false;
        return Failure::ofSystem().of("the FIFO cannot be opened again");
    }
    _feed.open(std::move(next), *_listener, WriterFeed::Coming::WithFirstBytes);
    return Done();
}

} // namespace spectrel
