#pragma once

#include "Platform/Sockets/FileDescriptor.h"
#include "Platform/StreamInput.h"

#include <QObject>

#include <cstdint>
#include <functional>
#include <memory>

class QSocketNotifier;

namespace spectrel {

/// Reads one writer's stream for a listener, a piece whenever there is one.
class WriterFeed {
public:
    enum class Coming : std::uint8_t { Told, WithFirstBytes };

    /// `onEnd` is called when the writer has ended, with the reason; the feed is then closed.
    explicit WriterFeed(std::function<void(const std::string& reason)> onEnd);
    ~WriterFeed();

    void open(FileDescriptor descriptor, StreamInput::Listener& listener, Coming coming);
    void close();
    bool isOpen() const
    {
        return static_cast<bool>(_descriptor);
    }
    /// Pieces read since the feed was made: whether a writer is silent.
    std::uint64_t pieces() const
    {
        return _pieces;
    }
    bool hasWriter() const
    {
        return _hasWriter;
    }
    /// A paused feed reads nothing; it may be paused before it is opened.
    void setPaused(bool isPaused);

private:
    void readPiece();

    std::function<void(const std::string&)> _onEnd;
    StreamInput::Listener* _listener = nullptr;
    FileDescriptor _descriptor;
    std::unique_ptr<QSocketNotifier> _notifier;
    bool _hasWriter = false;
    bool _isPaused = false;
    Bytes _piece;
    std::uint64_t _pieces = 0;
    QObject _retired; // owns the former notifiers until they are deleted: at the latest with the feed
};

} // namespace spectrel
