#pragma once

#include "Platform/MessagePort.h"

#include <functional>
#include <memory>
#include <string>

namespace spectrel {

/// One application a session: the first to start holds a message port, and a later one asks it to come to the front.
///
/// The ports' directory makes out the session: programs that meet different telephony services do not get in each
/// other's way.
class SingleInstance {
public:
    static constexpr const char* PortName = "org.spectrel.Spectrel.activation";

    /// Asked to come to the front. The token is what the asking program got from its compositor; it may be empty.
    using ActivationHandler = std::function<void(const std::string& activationToken)>;

    explicit SingleInstance(MessagePorts& ports)
        : _ports(ports)
    {
    }
    ~SingleInstance();
    SingleInstance(const SingleInstance&) = delete;
    SingleInstance& operator=(const SingleInstance&) = delete;

    /// True when another application runs and has been asked to come to the front; this one may go.
    bool activateOther(const std::string& activationToken);
    /// Becomes the one that is asked. Without a port, which another may hold meanwhile, nobody ever asks.
    void serve(ActivationHandler handler);

private:
    MessagePorts& _ports;
    std::shared_ptr<LocalMessagePort> _port;
};

} // namespace spectrel
