#pragma once

#include "Platform/MessagePort.h"
#include "Platform/TelephonyServer.h"

namespace spectrel {

/// The telephony service as a message port of a well-known name.
///
/// TelephonyProtocol.h has what is said; an answer is waited for a second. What goes wrong on the way has an error of
/// its own below.
class SocketTelephonyServer final : public TelephonyServer {
public:
    /// The domain of errors that this end found; the service's own errors come with the service's domain.
    static constexpr std::int32_t TransportDomain = -1;
    /// Errors -1 to -5 are the send status; these two follow.
    static constexpr std::int32_t NoAnswer = -10; // the service answered without data
    static constexpr std::int32_t UnreadableAnswer = -11; // no dictionary with an integer under "Error"

    /// The ports outlive the server.
    explicit SocketTelephonyServer(MessagePorts& ports)
        : _ports(ports)
    {
    }
    /// The service posts no notifications; the handler is not kept.
    std::unique_ptr<TelephonyServerConnection> RKServerConnectionCreate(NotificationHandler handler) override;

private:
    MessagePorts& _ports;
};

} // namespace spectrel
