#pragma once

#include "Telephony/LogSource.h"

#include <algorithm>
#include <cstdint>
#include <vector>

namespace spectrel {

/// Collects what a stream delivers.
class Collector final : public MessageSink {
public:
    bool deliver(ByteView message) override
    {
        if (isFull)
            return false;
        messages.emplace_back(message.begin(), message.end());
        return true;
    }
    std::size_t count(std::uint8_t type, std::uint8_t lowCode) const
    {
        return static_cast<std::size_t>(std::count_if(messages.begin(), messages.end(),
            [&](const Bytes& message) { return message[0] == type && message[3] == lowCode; }));
    }
    std::vector<Bytes> messages;
    bool isFull = false;
};

} // namespace spectrel
