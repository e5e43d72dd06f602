#pragma once

#include "Values/Bytes.h"
#include "Values/Result.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// The result of a send, numbered as the system's log lines show it ("got error=%d").
enum class SendStatus : std::int32_t {
    Success = 0,
    SendTimeout = -1, // the receiver's queue stayed full
    ReceiveTimeout = -2, // no reply in time
    Invalid = -3, // this port was invalidated, or its peer is gone
    TransportError = -4, // the body's size is out of bounds, or the system refused
    BecameInvalid = -5, // the peer went away between request and reply
};

/// Whether a request waits for the peer's answer.
enum class ReplyMode : std::uint8_t { None, Wait };

/// The receiving end of a named port.
class LocalMessagePort {
public:
    /// A message's id and body; what it returns is the answer where one is asked for, nothing being an empty answer.
    using MessageHandler = std::function<std::optional<Bytes>(std::int32_t id, ByteView body)>;
    using InvalidationHandler = std::function<void()>;

    virtual ~LocalMessagePort() = default;
    virtual const std::string& name() const = 0;
    /// Starts the delivery of messages on the main queue.
    virtual void serve() = 0;
    /// A paused port takes no messages: its senders' queues fill, and they have to wait. Safe within the handler, which
    /// is then not called again until the pause is over.
    virtual void setPaused(bool isPaused) = 0;
    /// Called once when the port becomes invalid, from outside or through `invalidate`; an empty handler removes it.
    virtual void setInvalidationHandler(InvalidationHandler handler) = 0;
    /// Closes the port and frees its name at once; a second call does nothing. Safe within the port's own handlers.
    virtual void invalidate() = 0;
    virtual bool isValid() const = 0;
};

/// The sending end of another process's port.
class RemoteMessagePort {
public:
    using InvalidationHandler = std::function<void()>;

    virtual ~RemoteMessagePort() = default;
    virtual const std::string& name() const = 0;
    /// Sends one message, waiting at most `sendTimeout` for room in the peer's queue. With `ReplyMode::Wait` it waits
    /// at most `receiveTimeout` for the answer, which then stands in `reply` (none: the peer answered without data).
    virtual SendStatus sendRequest(std::int32_t id, ByteView body, std::chrono::nanoseconds sendTimeout,
        std::chrono::nanoseconds receiveTimeout, ReplyMode replyMode, std::optional<Bytes>* reply) = 0;
    /// Called once when the peer's death is noticed; needs the run loop to turn. An empty handler removes it.
    virtual void setInvalidationHandler(InvalidationHandler handler) = 0;
    virtual void invalidate() = 0;
    /// False as soon as the peer is gone, whether or not the run loop has turned since.
    virtual bool isValid() const = 0;
    /// Called each time the peer's queue has room again after a send timed out; an empty handler removes it. For
    /// senders that must never wait: they send with a time-out of zero and go on when called.
    virtual void setWritableHandler(std::function<void()> handler) = 0;
};

/// The names of a user's session.
class MessagePorts {
public:
    struct LocalResult {
        std::shared_ptr<LocalMessagePort> port; // null: there is none
        bool existed = false; // the port of that name was made earlier by this very process
        std::optional<Failure> failure = std::nullopt; // without a port: why; `Exists`: another process holds the name
    };

    virtual ~MessagePorts() = default;
    virtual LocalResult createLocal(std::string_view name, LocalMessagePort::MessageHandler handler) = 0;
    /// Null when nobody serves the name.
    virtual std::shared_ptr<RemoteMessagePort> createRemote(std::string_view name) = 0;
};

} // namespace spectrel
