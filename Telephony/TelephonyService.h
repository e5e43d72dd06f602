#pragma once

#include "Platform/MessagePort.h"
#include "Platform/RunLoop.h"
#include "Telephony/LogChannel.h"
#include "Telephony/LogSource.h"

#include <cstddef>
#include <functional>
#include <map>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace spectrel {

/// The telephony service: opens log channels, several at once, each with its own client.
class TelephonyService {
public:
    static constexpr std::size_t MaxChannels = 64;

    TelephonyService(RunLoop& runLoop, const Clock& clock, MessagePorts& ports, LogSource& source);
    ~TelephonyService();
    TelephonyService(const TelephonyService&) = delete;
    TelephonyService& operator=(const TelephonyService&) = delete;

    /// Takes the service's port; false when another service holds it.
    bool start();
    std::size_t channels() const
    {
        return _channels.size();
    }
    std::vector<ChannelStatus> status() const;
    /// Called whenever a channel has come or gone.
    void setChangeHandler(std::function<void()> handler)
    {
        _changeHandler = std::move(handler);
    }

private:
    Bytes handleRequest(std::int32_t id, ByteView body);
    void endChannels();
    void reportChange();

    RunLoop& _runLoop;
    const Clock& _clock;
    MessagePorts& _ports;
    LogSource& _source;
    std::shared_ptr<LocalMessagePort> _port;
    std::map<unsigned, std::unique_ptr<LogChannel>> _channels;
    unsigned _latestNumber = 0;
    std::function<void()> _changeHandler;
};

} // namespace spectrel
