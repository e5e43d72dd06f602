#pragma once

#include "Records/Recording.h"
#include "Values/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>

namespace spectrel {

/// Where a stream's messages go: one channel.
class MessageSink {
public:
    virtual ~MessageSink() = default;
    /// Delivers one message, or lets it go when the client did not ask for its code. False when the client has no room
    /// now: nothing was delivered, and `LogStream::resume` is called once there is room.
    virtual bool deliver(ByteView message) = 0;
    /// Whether the client asked for it; one that is not wanted is delivered at any time, and let go.
    virtual bool wants(ByteView message) const
    {
        static_cast<void>(message);
        return true;
    }
    /// Says to the client that so many messages were lost before the next one. False when it has no room now.
    virtual bool reportLoss(std::uint64_t messages)
    {
        static_cast<void>(messages);
        return true;
    }
};

/// One channel's stream; it ends with its destruction.
class LogStream {
public:
    virtual ~LogStream() = default;
    /// There is room again after `deliver` had refused a message.
    virtual void resume() = 0;
    /// Messages that wait for the client to have room.
    virtual std::size_t waiting() const
    {
        return 0;
    }
    /// Messages that the client was too slow for.
    virtual std::uint64_t lost() const
    {
        return 0;
    }
};

/// A baseband: real, recorded or simulated.
class LogSource {
public:
    virtual ~LogSource() = default;
    virtual Technology technology() const = 0;
    /// False while the technology is not known yet; no channel is opened then.
    virtual bool isReady() const
    {
        return true;
    }
    /// What it is and how far it has come, in one line for people.
    virtual std::string status() const
    {
        return std::string(technologyName(technology()));
    }
    /// Starts streaming to one channel; the sink outlives the stream.
    virtual std::unique_ptr<LogStream> start(MessageSink& sink) = 0;
    /// `handler` is called from the main queue when another baseband is to speak, or none for now: `technology` may be
    /// another one, and what was heard so far is no longer so. The channels then end, so that their clients begin anew.
    /// Sources of one baseband never call it.
    virtual void setBasebandHandler(std::function<void()> handler)
    {
        static_cast<void>(handler);
    }
};

} // namespace spectrel
