#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// The telephony framework's answer to the wish for a log channel.
struct LogChannelResult {
    std::int32_t domain = 0;
    std::int32_t error = 0; // 0: opened
    std::optional<std::string> portName; // the service's end of the channel; may be absent or empty
};

/// A short-lived connection to the telephony service.
class TelephonyServerConnection {
public:
    virtual ~TelephonyServerConnection() = default;
    /// `_RKServerConnectionNetworkMonitorCreateLogChannel`: asks the service to open a log channel that sends to the
    /// named local port.
    virtual LogChannelResult RKServerConnectionNetworkMonitorCreateLogChannel(std::string_view localPortName) = 0;
};

/// How a program reaches the telephony service.
class TelephonyServer {
public:
    /// Name and details of a notification; the monitor refreshes whatever they are.
    using NotificationHandler = std::function<void(std::string_view name)>;

    virtual ~TelephonyServer() = default;
    /// `_RKServerConnectionCreate`; null when the service does not run.
    virtual std::unique_ptr<TelephonyServerConnection> RKServerConnectionCreate(NotificationHandler handler) = 0;
};

} // namespace spectrel
