#pragma once

#include "Platform/Sockets/WriterFeed.h"
#include "Platform/StreamInput.h"
#include "Values/Result.h"

#include <QObject>

#include <memory>
#include <string>

namespace spectrel {

/// Standard input, a FIFO or a device. A FIFO is opened anew when its last writer has closed it.
class PipeInput final : public StreamInput {
public:
    /// Fails when it cannot be opened or is of another kind. "-" is standard input.
    static Result<std::unique_ptr<StreamInput>> open(const std::string& path);

    const std::string& name() const override
    {
        return _name;
    }
    bool takesFurtherWriters() const override
    {
        return _isFifo;
    }
    void start(Listener& listener) override;
    void setPaused(bool isPaused) override
    {
        _feed.setPaused(isPaused);
    }
    void dropWriter() override;

private:
    PipeInput(std::string path, FileDescriptor descriptor, bool isFifo);
    void end(const std::string& reason);
    Outcome openAnew();

    std::string _path;
    std::string _name;
    FileDescriptor _first; // until it starts
    bool _isFifo;
    Listener* _listener = nullptr;
    QObject _later; // ends what waits to be done
    WriterFeed _feed;
};

} // namespace spectrel
