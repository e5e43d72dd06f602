#pragma once

#include "Analysis/Bands/Bands.h"

#include <cstdio>
#include <string>
#include <vector>

namespace spectrel {

/// Channels as one line each can be read: "3 FDD downlink 1300=1815.0000 19300=1720.0000".
inline std::string channelText(const BandChannel& channel)
{
    char text[128];
    std::snprintf(text, sizeof text, "%s %s %s %u=%.4f", std::string(channel.band).c_str(),
        std::string(duplexName(channel.duplex)).c_str(), std::string(directionName(channel.direction)).c_str(),
        channel.downlinkChannel, channel.downlinkMHz);
    std::string line = text;
    if (channel.uplinkChannel) {
        std::snprintf(text, sizeof text, " %u=%.4f", *channel.uplinkChannel, channel.uplinkMHz.value_or(-1));
        line += text;
    }
    return line;
}

inline std::vector<std::string> channelTexts(const std::vector<BandChannel>& channels)
{
    std::vector<std::string> texts;
    for (const BandChannel& channel : channels)
        texts.push_back(channelText(channel));
    return texts;
}

} // namespace spectrel
