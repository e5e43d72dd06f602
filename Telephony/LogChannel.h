#pragma once

#include "Platform/MessagePort.h"
#include "Platform/RunLoop.h"
#include "Platform/Value.h"
#include "Telephony/LogSource.h"

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
    std::size_t count() const
    {
        return _codes.size();
    }
    bool wantsEverything() const
    {
        return _wantsEverything;
    }

private:
    std::unordered_set<std::uint32_t> _codes;
    bool _wantsEverything = false;
};

/// One client's log channel: answers its requests and streams what it asked for to its local port.
class LogChannel final : public MessageSink {
public:
    /// `onEnd` is called from the main queue once the client has gone; it may destroy the channel.
    /// Null when the port cannot be made or nobody serves the client's.
    static std::unique_ptr<LogChannel> open(RunLoop& runLoop, MessagePorts& ports, LogSource& source,
        const std::string& name, const std::string& clientPort, std::function<void()> onEnd);
    ~LogChannel() override;

    bool deliver(ByteView message) override;

private:
    LogChannel(RunLoop& runLoop, LogSource& source, std::string name, std::function<void()> onEnd);
    std::optional<Bytes> handleRequest(std::int32_t id, ByteView body);
    void startStreaming(Subscription subscription);
    void end();

    RunLoop& _runLoop;
    LogSource& _source;
    std::string _name;
    std::function<void()> _onEnd;
    std::shared_ptr<bool> _alive;
    std::shared_ptr<LocalMessagePort> _requests;
    std::shared_ptr<RemoteMessagePort> _client;
    std::optional<Subscription> _subscription;
    std::unique_ptr<LogStream> _stream;
};

} // namespace spectrel
