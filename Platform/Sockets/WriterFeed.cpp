#include "Platform/Sockets/WriterFeed.h"

#include <QSocketNotifier>

#include <cerrno>
#include <cstring>
#include <unistd.h>
#include <utility>

namespace spectrel {

WriterFeed::WriterFeed(std::function<void(const std::string& reason)> onEnd)
    : _onEnd(std::move(onEnd))
    , _piece(StreamInput::LargestRead)
{
}

WriterFeed::~WriterFeed() = default;

void WriterFeed::open(FileDescriptor descriptor, StreamInput::Listener& listener, Coming coming)
{
    close(); // the descriptor comes in first: of a FIFO, one end stays open
    _listener = &listener;
    _descriptor = std::move(descriptor);
    _notifier = std::make_unique<QSocketNotifier>(_descriptor.number(), QSocketNotifier::Read);
    _notifier->setEnabled(!_isPaused);
    QObject::connect(_notifier.get(), &QSocketNotifier::activated, [this] { readPiece(); });
    if (coming == Coming::Told) {
        _hasWriter = true;
        listener.writerCame();
    }
}

void WriterFeed::close()
{
    if (_notifier) {
        _notifier->setEnabled(false);
        _notifier->setParent(&_retired);
        _notifier.release()->deleteLater(); // it may be the one that called
    }
    _descriptor.close();
    _hasWriter = false;
}

void WriterFeed::setPaused(bool isPaused)
{
    _isPaused = isPaused;
    if (_notifier)
        _notifier->setEnabled(!isPaused);
}

/// One read for each time that there is something to read: standard input may be of the kind that blocks.
void WriterFeed::readPiece()
{
    if (!isOpen() || _isPaused)
        return;
    const ssize_t count = ::read(_descriptor.number(), _piece.data(), _piece.size());
    if (count < 0 && (errno == EINTR || errno == EAGAIN))
        return;
    if (count <= 0)
        return _onEnd(count < 0 ? std::strerror(errno) : "");
    ++_pieces;
    if (!std::exchange(_hasWriter, true))
        _listener->writerCame();
    _listener->bytesCame(ByteView(_piece).first(static_cast<std::size_t>(count)));
}

} // namespace spectrel
