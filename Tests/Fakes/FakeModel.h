#pragma once

#include "Monitor/MonitorModel.h"

#include <functional>
#include <string>
#include <string_view>

namespace spectrel {

/// A model whose display and session the test sets.
class FakeModel final : public MonitorModel {
public:
    ~FakeModel() override
    {
        if (onEnd)
            onEnd();
    }
    bool isConnected() const override
    {
        return connected;
    }
    void restartMonitor() override
    {
        ++restarts;
    }
    const std::string& lostReason() const override
    {
        return reason;
    }
    NodeRef topLevelNodes() override
    {
        return root;
    }
    NodeRef nodeAtPath(std::string_view path) override
    {
        const auto found = index.find(std::string(path));
        return found == index.end() ? nullptr : found->second;
    }
    ListRef getSaveContents() override
    {
        ++saveRequests;
        return saveContents;
    }

    Playback* playback() override
    {
        return playing;
    }

    void setDisplay(const Value& display)
    {
        index.clear();
        root = SpectrelModelNode::makeTreeFromObject(display, index);
    }

    bool connected = false;
    std::string reason;
    int restarts = 0;
    int saveRequests = 0;
    ListRef saveContents;
    Playback* playing = nullptr; // set while it is made
    NodeRef root;
    PathIndex index;
    std::function<void()> onEnd;
};

} // namespace spectrel
