#pragma once

#include "Monitor/MonitorModel.h"
#include "Monitor/SpectrelModel.h"
#include "Platform/Lifetime.h"
#include "Platform/RunLoop.h"

#include <string>
#include <string_view>

namespace spectrel {

/// What a snapshot shows as one display: its entries, the newest first, each under its date and description with the
/// display that it holds; then what is no display (the binary log), when the snapshot was made and its description.
Value displayOfSnapshot(const Dictionary& snapshot);

/// The model of a snapshot that is browsed; it never changes.
class SnapshotModel final : public MonitorModel {
public:
    /// `runLoop` and `observer` outlive the model.
    SnapshotModel(RunLoop& runLoop, SpectrelModelObserver& observer, const Dictionary& snapshot);

    bool isConnected() const override
    {
        return _isStarted;
    }
    /// Shows the entries; once.
    void restartMonitor() override;
    NodeRef topLevelNodes() override
    {
        return _nodes;
    }
    NodeRef nodeAtPath(std::string_view path) override
    {
        return nodeInIndex(_nodesByPath, path);
    }
    ListRef getSaveContents() override
    {
        return nullptr;
    }

private:
    RunLoop& _runLoop;
    SpectrelModelObserver& _observer;
    Lifetime _lifetime; // of jobs on the queue
    PathIndex _nodesByPath;
    NodeRef _nodes;
    bool _isStarted = false;
};

} // namespace spectrel
