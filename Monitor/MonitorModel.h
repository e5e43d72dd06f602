#pragma once

#include "Monitor/Playback.h"
#include "Monitor/SpectrelModelNode.h"
#include "Values/List.h"

#include <string>
#include <string_view>

namespace spectrel {

/// What the screens ask of a model: the live session's, or one that plays a recording.
class MonitorModel {
public:
    virtual ~MonitorModel() = default;

    virtual bool isConnected() const = 0;
    virtual void restartMonitor() = 0;
    /// Why there is no session, for people; empty while there is one or nothing is known.
    virtual const std::string& lostReason() const
    {
        static const std::string None;
        return None;
    }

    /// The root of the current tree, built at need; null when there is none.
    virtual NodeRef topLevelNodes() = 0;
    virtual NodeRef nodeAtPath(std::string_view path) = 0;
    /// What a snapshot saves; null when there is nothing that could tell.
    virtual ListRef getSaveContents() = 0;

    /// The time line of a model that plays a recording; null where there is nothing to play.
    virtual Playback* playback()
    {
        return nullptr;
    }
};

} // namespace spectrel
