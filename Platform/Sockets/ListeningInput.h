#pragma once

#include "Platform/Sockets/WriterFeed.h"
#include "Platform/StreamInput.h"
#include "Values/Result.h"

#include <memory>
#include <string>

class QSocketNotifier;

namespace spectrel {

/// A listening Unix or TCP socket; one writer at a time is taken, the next ones wait to be accepted.
class ListeningInput final : public StreamInput {
public:
    /// Listens at the path for this user's writers; a socket that a dead process left there is removed.
    static Result<std::unique_ptr<StreamInput>> openUnix(const std::string& path);
    /// "HOST:PORT", "[IPv6]:PORT" or "PORT", which listens on this machine alone.
    static Result<std::unique_ptr<StreamInput>> openTCP(const std::string& address);
    ~ListeningInput() override;

    const std::string& name() const override
    {
        return _name;
    }
    bool takesFurtherWriters() const override
    {
        return true;
    }
    void start(Listener& listener) override;
    void setPaused(bool isPaused) override;
    void dropWriter() override;

private:
    ListeningInput(std::string name, std::string path, FileDescriptor socket);
    void acceptWriter();
    void end(const std::string& reason);
    void listenIfFree();

    std::string _name;
    std::string _path; // to be removed at the end; empty: none
    FileDescriptor _socket;
    std::unique_ptr<QSocketNotifier> _notifier; // off while there is a writer, and in a pause
    bool _isPaused = false;
    Listener* _listener = nullptr;
    WriterFeed _feed;
};

} // namespace spectrel
