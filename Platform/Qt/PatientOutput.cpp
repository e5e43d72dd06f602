#include "Platform/Qt/PatientOutput.h"

#include "Platform/Qt/QtRunLoop.h"
#include "Values/OwnFile.h"

#include <QSocketNotifier>
#include <QTimer>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

namespace spectrel {

namespace {

constexpr std::size_t PieceSize = 4096; // what a pipe that can be written takes without waiting
constexpr int ReaderInterval = 100; // milliseconds between looks for a FIFO's reader
constexpr std::chrono::hours Forever {24 * 24};
constexpr std::chrono::seconds LastPatience {1};

/// A description of the pipe that is ours alone, so that it can be made not to block, for nobody else.
int openAnew(int descriptor)
{
    return ::open(("/proc/self/fd/" + std::to_string(descriptor)).c_str(), O_WRONLY | O_NONBLOCK | O_CLOEXEC);
}

} // namespace

struct PatientOutput::Private {
    enum class Kind { File, Socket, OwnPipe, Other };

    ~Private()
    {
        notifier.reset();
        if (stream)
            std::fclose(stream);
        if (descriptor >= 0)
            ::close(descriptor);
    }
    void use(int opened);
    ssize_t writePiece();
    bool canBeWritten() const;
    void push();
    void settle();
    void fail(int error);
    void findReader();

    int descriptor = -1;
    Kind kind = Kind::Other;
    std::string fifo; // that still has no reader
    std::string bytes; // that wait, from `taken` on
    std::size_t taken = 0;
    std::optional<Failure> failure;
    std::function<void()> changed;
    std::unique_ptr<QSocketNotifier> notifier;
    QTimer readerTimer;
    std::FILE* stream = nullptr;
};

void PatientOutput::Private::use(int opened)
{
    descriptor = opened;
    struct stat status { };
    ::fstat(descriptor, &status);
    if (S_ISREG(status.st_mode)) {
        kind = Kind::File;
        return;
    }
    if (S_ISSOCK(status.st_mode)) {
        kind = Kind::Socket;
    } else if (S_ISFIFO(status.st_mode)) {
        if (const int own = openAnew(descriptor); own >= 0) {
            ::close(std::exchange(descriptor, own));
            kind = Kind::OwnPipe;
        }
    }
    notifier = std::make_unique<QSocketNotifier>(descriptor, QSocketNotifier::Write);
    notifier->setEnabled(false);
    QObject::connect(notifier.get(), &QSocketNotifier::activated, [this] { push(); });
}

bool PatientOutput::Private::canBeWritten() const
{
    pollfd output {descriptor, POLLOUT, 0};
    return kind != Kind::Other || ::poll(&output, 1, 0) == 1;
}

ssize_t PatientOutput::Private::writePiece()
{
    const char* const from = bytes.data() + taken;
    const std::size_t length = bytes.size() - taken;
    if (kind == Kind::Socket)
        return ::send(descriptor, from, length, MSG_DONTWAIT | MSG_NOSIGNAL);
    if (!canBeWritten()) {
        errno = EAGAIN;
        return -1;
    }
    return ::write(descriptor, from, kind == Kind::Other ? std::min(length, PieceSize) : length);
}

/// Writes as much as is taken now.
void PatientOutput::Private::push()
{
    while (descriptor >= 0 && !failure && taken < bytes.size()) {
        const ssize_t written = writePiece();
        if (written >= 0)
            taken += static_cast<std::size_t>(written);
        else if (errno == EAGAIN)
            break;
        else if (errno != EINTR)
            return fail(errno);
    }
    settle();
}

void PatientOutput::Private::settle()
{
    const bool isEmpty = taken == bytes.size();
    const bool hasWaited = notifier && notifier->isEnabled();
    if (isEmpty || taken > Plenty) {
        bytes.erase(0, taken);
        taken = 0;
    }
    if (notifier)
        notifier->setEnabled(!isEmpty);
    if (isEmpty && hasWaited && changed)
        changed();
}

void PatientOutput::Private::fail(int error)
{
    failure = Failure::ofSystem(error);
    notifier.reset();
    bytes.clear();
    taken = 0;
    if (changed)
        QTimer::singleShot(0, &readerTimer, changed);
}

/// Nobody may read a FIFO for now; that is no reason to wait for it.
void PatientOutput::Private::findReader()
{
    const int opened = ::open(fifo.c_str(), O_WRONLY | O_NONBLOCK | O_NOFOLLOW | O_CLOEXEC);
    if (opened < 0) {
        if (errno != ENXIO)
            fail(errno);
        return;
    }
    readerTimer.stop();
    use(opened);
    push();
}

PatientOutput::PatientOutput(std::unique_ptr<Private> made)
    : _private(std::move(made))
{
}

PatientOutput::~PatientOutput() = default;

Result<std::unique_ptr<PatientOutput>> PatientOutput::open(const std::string& path)
{
    auto made = std::make_unique<Private>();
    struct stat status { };
    if (path == "-") {
        const int own = ::fcntl(STDOUT_FILENO, F_DUPFD_CLOEXEC, 3);
        if (own < 0)
            return Failure::ofSystem();
        made->use(own);
    } else if (::lstat(path.c_str(), &status) == 0 && S_ISFIFO(status.st_mode)) {
        if (status.st_uid != ::geteuid())
            return Failure {"it belongs to somebody else", Failure::Code::Refused};
        made->fifo = path;
        Private* const self = made.get();
        QObject::connect(&made->readerTimer, &QTimer::timeout, [self] { self->findReader(); });
        made->readerTimer.start(ReaderInterval);
        made->findReader();
    } else {
        const auto opened = openOwnFile(path, IfThere::Overwrite);
        if (!opened)
            return opened.failure();
        made->use(*opened);
    }
    return std::unique_ptr<PatientOutput>(new PatientOutput(std::move(made)));
}

Outcome PatientOutput::write(ByteView bytes)
{
    if (!_private->failure) {
        _private->bytes.append(reinterpret_cast<const char*>(bytes.data()), bytes.size());
        _private->push();
    }
    return _private->failure ? Outcome(*_private->failure) : Done();
}

std::size_t PatientOutput::waiting() const
{
    return _private->bytes.size() - _private->taken;
}

const std::optional<Failure>& PatientOutput::failure() const
{
    return _private->failure;
}

void PatientOutput::setChangeHandler(std::function<void()> handler)
{
    _private->changed = std::move(handler);
}

std::FILE* PatientOutput::stream()
{
    if (_private->stream)
        return _private->stream;
    const auto write = [](void* output, const char* bytes, std::size_t length) -> ssize_t {
        const ByteView view(reinterpret_cast<const std::uint8_t*>(bytes), length);
        return static_cast<PatientOutput*>(output)->write(view) ? static_cast<ssize_t>(length) : 0;
    };
    _private->stream = ::fopencookie(this, "w", {nullptr, write, nullptr, nullptr});
    if (_private->stream)
        std::setvbuf(_private->stream, nullptr, _IONBF, 0);
    return _private->stream;
}

Outcome PatientOutput::finish(QtRunLoop& runLoop, const std::function<bool()>& isAskedToEnd)
{
    const auto isOver = [this] { return waiting() == 0 || failure().has_value(); };
    runLoop.runUntil([&] { return isOver() || isAskedToEnd(); }, Forever);
    runLoop.runUntil(isOver, LastPatience);
    if (failure())
        return *failure();
    if (waiting() > 0)
        return Failure {"the last " + std::to_string(waiting()) + " bytes found no reader"};
    return Done();
}

} // namespace spectrel
