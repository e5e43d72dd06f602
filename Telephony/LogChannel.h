#pragma once

#include "Platform/Clock.h"
#include "Platform/Lifetime.h"
#include "Platform/MessagePort.h"
#include "Platform/RunLoop.h"
#include "Telephony/LogSource.h"
#include "Values/Value.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <unordered_set>

namespace spectrel {

/// The codes that a client asked for, as they are routed.
class Subscription {
public:
    /// From a start command; a command without any code list (the dictionary-reporting baseband's) wants everything.
    /// None when it is no start command.
    static std::optional<Subscription> fromStartCommand(const Value& command);

    /// Messages that have no code are wanted by everybody.
    bool wants(ByteView message) const;
    /// "12 codes", "everything".
    std::string description() const
    {
        return _wantsEverything ? "everything"
                                : std::to_string(_codes.size()) + (_codes.size() == 1 ? " code" : " codes");
    }

private:
    std::unordered_set<std::uint32_t> _codes;
    bool _wantsEverything = false;
};

/// How one channel is doing.
struct ChannelStatus {
    std::string name; // "channel 1"
    std::string client; // its port, without what every client's has behind its name
    std::string wish; // "12 codes"
    bool isStreaming = false;
    bool isFull = false; // the client has no room
    std::chrono::nanoseconds started {0}; // steady: with the latest start command
    std::uint64_t sent = 0;
    std::uint64_t notAskedFor = 0;
    std::size_t waiting = 0;
    std::uint64_t lost = 0;
};

/// One client's log channel: answers its requests and streams what it asked for to its local port.
class LogChannel final : public MessageSink {
public:
    /// `onEnd` is called from the main queue once the client has gone; it may destroy the channel.
    /// Null when the port cannot be made or nobody serves the client's.
    static std::unique_ptr<LogChannel> open(RunLoop& runLoop, const Clock& clock, MessagePorts& ports,
        LogSource& source, unsigned number, const std::string& clientPort, std::function<void()> onEnd);
    ~LogChannel() override;

    bool deliver(ByteView message) override;

    /// Of the port for requests.
    const std::string& portName() const
    {
        return _requests->name();
    }
    ChannelStatus status() const;

private:
    LogChannel(RunLoop& runLoop, const Clock& clock, LogSource& source, unsigned number, std::function<void()> onEnd);
    std::optional<Bytes> handleRequest(std::int32_t id, ByteView body);
    void startStreaming(Subscription subscription);
    void end();

    RunLoop& _runLoop;
    const Clock& _clock;
    LogSource& _source;
    ChannelStatus _status; // but for what the stream knows
    std::function<void()> _onEnd;
    Lifetime _lifetime;
    std::shared_ptr<LocalMessagePort> _requests;
    std::shared_ptr<RemoteMessagePort> _client;
    std::optional<Subscription> _subscription;
    std::unique_ptr<LogStream> _stream;
};

} // namespace spectrel
