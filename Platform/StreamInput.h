#pragma once

#include "Values/Bytes.h"

#include <memory>
#include <string>

namespace spectrel {

/// Where a live stream of bytes comes from. Writers come one after the other; the next waits until one has ended.
class StreamInput {
public:
    static constexpr std::size_t LargestRead = 64 * 1024;

    /// Called from the main queue. It may pause the input and drop the writer, but not end the input.
    class Listener {
    public:
        virtual ~Listener() = default;
        virtual void writerCame() = 0;
        virtual void bytesCame(ByteView bytes) = 0; // at most `LargestRead`
        /// `reason` is empty when the writer closed the stream.
        virtual void writerEnded(const std::string& reason) = 0;
    };

    virtual ~StreamInput() = default;
    /// As a person would say it, such as "standard input" or "tcp:127.0.0.1:4000".
    virtual const std::string& name() const = 0;
    /// Whether another writer may come after one has ended.
    virtual bool takesFurtherWriters() const = 0;
    /// Whether programs of others can write, such as a web page over TCP: a stream then has to say what it is.
    virtual bool isOpenToOthers() const
    {
        return false;
    }
    virtual void start(Listener& listener) = 0;
    /// A paused input reads nothing, so that its writer has to wait.
    virtual void setPaused(bool isPaused) = 0;
    /// Ends the current writer's stream from this side; `writerEnded` is not called.
    virtual void dropWriter() = 0;
};

} // namespace spectrel
