#pragma once

#include "Platform/Sockets/WriterFeed.h"
#include "Platform/StreamInput.h"
#include "Values/Result.h"

#include <QTimer>

#include <chrono>
#include <memory>
#include <string>

class QSocketNotifier;

namespace spectrel {

/// A listening Unix or TCP socket; one writer at a time is taken, the next ones wait to be accepted. A writer that
/// sends nothing for a while, although it is read, gives way when another waits.
class ListeningInput final : public StreamInput {
public:
    static constexpr std::chrono::seconds LongestSilence {30};

    /// Listens at the path for this user's writers; a socket that a dead process left there is removed.
    static Result<std::unique_ptr<StreamInput>> openUnix(
        const std::string& path, std::chrono::milliseconds longestSilence = LongestSilence);
    /// "HOST:PORT", "[IPv6]:PORT" or "PORT", which listens on this machine alone.
    static Result<std::unique_ptr<StreamInput>> openTCP(
        const std::string& address, std::chrono::milliseconds longestSilence = LongestSilence);
    ~ListeningInput() override;

    const std::string& name() const override
    {
        return _name;
    }
    bool takesFurtherWriters() const override
    {
        return true;
    }
    bool isOpenToOthers() const override
    {
        return _path.empty(); // TCP
    }
    void start(Listener& listener) override;
    void setPaused(bool isPaused) override;
    void dropWriter() override;

private:
    ListeningInput(std::string name, std::string path, FileDescriptor socket, std::chrono::milliseconds longestSilence);
    void acceptWriter();
    void end(const std::string& reason);
    void listenIfFree();
    void checkSilence();
    bool anotherWaits() const;

    std::string _name;
    std::string _path; // to be removed at the end; empty: none
    FileDescriptor _socket;
    std::unique_ptr<QSocketNotifier> _notifier; // off while there is a writer, and in a pause
    bool _isPaused = false;
    Listener* _listener = nullptr;
    std::chrono::milliseconds _longestSilence;
    std::uint64_t _piecesBefore = 0; // of the writer, when the silence was last looked for
    int _silentSteps = 0;
    QTimer _silenceTimer; // runs while a writer is read
    WriterFeed _feed;
};

} // namespace spectrel
