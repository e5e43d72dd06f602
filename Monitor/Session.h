#pragma once

#include "LogGenerator/LogGenerator.h"
#include "Monitor/DisplayState.h"
#include "Platform/Context.h"
#include "Platform/Lifetime.h"
#include "Platform/MessagePort.h"
#include "Platform/RunLoop.h"
#include "Platform/TelephonyServer.h"
#include "Values/Bytes.h"
#include "Values/Value.h"

#include <chrono>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// Why there is no session.
enum class SessionLossCause : std::uint8_t {
    None, // there is one, or nothing has been tried
    NoLocalPort,
    LocalPortExists,
    NoService,
    ChannelRefused,
    NoChannel,
    NoRemotePort,
    RequestNotMade,
    RequestNotSent,
    NoReply,
    ReplyNotRead,
    NoAnswer,
    UnknownTechnology,
    CommandNotMade,
    CommandNotSent,
    NoPorts, // for want of a name
};

struct SessionLoss {
    SessionLossCause cause = SessionLossCause::None;
    std::string text; // for people; empty without a cause
};

/// Who receives what a session delivers. Everything comes from the main queue.
class SessionSink {
public:
    virtual ~SessionSink() = default;
    /// The service has named its technology: `generator` is that technology's from now on.
    virtual void useTechnology(const Value& technology) = 0;
    /// The one that knows the start command; null when there is none.
    virtual LogGenerator* generator() = 0;
    /// One log message body. What it raises ends the process.
    virtual void receive(ByteView body) = 0;
    /// A refresh tick, or news of the connection to the service.
    virtual void sessionDidTick() { }
    /// The session was opened or lost, or the reason why there is none has changed.
    virtual void sessionDidChange() = 0;
};

/// The log channel to the telephony service: opens it, tries again when it cannot be had or is lost, and delivers the
/// messages to a sink.
class Session {
public:
    /// What a session needs of the platform; all outlive it.
    struct Services {
        RunLoop& runLoop;
        MessagePorts& ports;
        TelephonyServer& telephony;
        Context context {};
    };

    static constexpr std::chrono::seconds RetryDelay {5};
    static constexpr std::chrono::seconds RequestTimeout {1};
    static constexpr std::string_view PortSuffix = ".BasebandStateReport.LogChannel"; // of every local port

    /// Opens nothing. The local port is named `portPrefix` + `PortSuffix`; the sink outlives the session.
    Session(Services services, SessionSink& sink, std::string portPrefix);
    ~Session();
    Session(const Session&) = delete;
    Session& operator=(const Session&) = delete;

    /// Both ports are there.
    bool isConnected() const
    {
        return _recvPort && _sendPort;
    }
    bool createPorts();
    void destroyPorts();
    void configureGenerator();
    void start();
    void restart();
    /// Looks whether the service still lives, as at each tick.
    void refresh();
    /// Takes no more messages until the next tick; while running.
    void pause();

    const SessionLoss& loss() const
    {
        return _loss;
    }
    /// The technology value that the service answered last; empty before.
    const std::string& technology() const
    {
        return _technology;
    }

private:
    void handleMessage(std::int32_t id, ByteView body) noexcept;
    void handleInvalidation(const LocalMessagePort* port);
    bool openLogChannel(const std::string& localName, std::string& serviceName);
    std::optional<Value> askTechnology();
    bool open();
    void closePorts();
    void announceChange();
    bool fail(SessionLossCause cause, std::int64_t code = 0);

    Services _services;
    SessionSink& _sink;
    std::string _portPrefix;
    SessionLoss _loss; // of the latest attempt to open a session
    bool _attemptHasCause = false;
    bool _announcedRunning = false; // what the sink heard last
    std::string _announcedText;
    std::string _technology;
    Lifetime _lifetime;

    std::shared_ptr<LocalMessagePort> _recvPort;
    std::shared_ptr<RemoteMessagePort> _sendPort;
    std::unique_ptr<Timer> _displayUpdateTimer; // while running
    bool _isPaused = false;
};

} // namespace spectrel
