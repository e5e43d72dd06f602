#pragma once

#include "Telephony/LogSource.h"
#include "Values/Bytes.h"

#include <cstddef>
#include <cstdint>
#include <deque>

namespace spectrel {

/// Live messages on their way to one client: what it has no room for waits here. The queue is bounded; beyond it the
/// oldest go. Once the client takes messages again the loss is reported, to the client at the place where they are
/// missing.
class ChannelQueue {
public:
    static constexpr std::size_t MaxMessages = 4096;
    static constexpr std::size_t MaxBytes = 8 * 1024 * 1024;

    explicit ChannelQueue(MessageSink& sink)
        : _sink(sink)
    {
    }
    void send(ByteView message);
    /// The client has room again.
    void drain();

    std::size_t waiting() const
    {
        return _waiting.size();
    }
    std::uint64_t lost() const
    {
        return _lost;
    }

private:
    void dropOldest();
    bool reportLoss();

    MessageSink& _sink;
    std::deque<Bytes> _waiting;
    std::size_t _bytes = 0; // of those waiting
    std::uint64_t _lost = 0;
    std::uint64_t _reportedLost = 0; // to the client
    std::uint64_t _printedLost = 0;
};

} // namespace spectrel
