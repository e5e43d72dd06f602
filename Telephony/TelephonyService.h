#pragma once

#include "Platform/MessagePort.h"
#include "Platform/RunLoop.h"
#include "Telephony/LogChannel.h"
#include "Telephony/LogSource.h"

#include <cstddef>
#include <map>
#include <memory>
#include <string>

namespace spectrel {

/// The telephony service: opens log channels, several at once, each with its own client.
class TelephonyService {
public:
    static constexpr std::size_t MostChannels = 64;

    TelephonyService(RunLoop& runLoop, MessagePorts& ports, LogSource& source);
    ~TelephonyService();
    TelephonyService(const TelephonyService&) = delete;
    TelephonyService& operator=(const TelephonyService&) = delete;

    /// Takes the service's port; false when another service holds it.
    bool start();
    std::size_t channels() const
    {
        return _channels.size();
    }

private:
    Bytes handleRequest(std::int32_t id, ByteView body);
    void endChannels();

    RunLoop& _runLoop;
    MessagePorts& _ports;
    LogSource& _source;
    std::shared_ptr<LocalMessagePort> _port;
    std::map<unsigned, std::unique_ptr<LogChannel>> _channels;
    unsigned _lastChannel = 0;
};

} // namespace spectrel
