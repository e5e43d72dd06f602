#pragma once

#include "Platform/MessagePort.h"
#include "Platform/TelephonyServer.h"

#include <functional>
#include <map>
#include <string>
#include <vector>

namespace spectrel {

/// Message ports within one test, with failures by name.
class FakeMessagePorts final : public MessagePorts {
public:
    struct Local;
    struct Remote;
    struct Sent {
        std::int32_t id = 0;
        std::string body;
        std::chrono::nanoseconds sendTimeout {0};
        std::chrono::nanoseconds receiveTimeout {0};
        ReplyMode replyMode = ReplyMode::None;
    };
    /// What a request is met with.
    struct Answer {
        SendStatus status = SendStatus::Success;
        std::optional<Bytes> reply;
    };

    LocalResult createLocal(std::string_view name, LocalMessagePort::MessageHandler handler) override;
    std::shared_ptr<RemoteMessagePort> createRemote(std::string_view name) override;

    /// Delivers a message to the local port of that name, as its peer would; false when there is none, or when
    /// it is paused.
    bool deliver(const std::string& name, std::int32_t id, ByteView body);
    /// The same, with the answer that the port's handler gives.
    std::optional<Bytes> request(const std::string& name, std::int32_t id, ByteView body);
    /// Tells every remote port that its peer has room again.
    void makeRoom();
    /// Invalidates a local port from outside.
    void invalidateLocal(const std::string& name);
    /// Ends the peer of every remote port.
    void killPeers();
    std::size_t localPorts() const;

    bool refuseLocal = false; // another process holds the name
    bool existingLocal = false; // this process made the name earlier
    bool refuseRemote = false;
    std::function<Answer(const Sent&)> answer; // by default every request succeeds without a reply
    std::vector<Sent> sent;

private:
    friend struct Remote;
    std::map<std::string, std::weak_ptr<Local>> _locals;
    std::vector<std::weak_ptr<Remote>> _remotes;
};

/// A telephony service that hands out a channel, or fails as told.
class FakeTelephonyServer final : public TelephonyServer {
public:
    std::unique_ptr<TelephonyServerConnection> RKServerConnectionCreate(NotificationHandler handler) override;

    bool isRunning = true;
    LogChannelResult result {0, 0, "channel"};
    std::vector<std::string> channelsFor; // the local port names that asked
    NotificationHandler notification; // of the last connection
};

} // namespace spectrel
