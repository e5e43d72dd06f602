#pragma once

#include "Values/Result.h"

#include <condition_variable>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <vector>

namespace spectrel {

/// Has files brought to the disk (fsync), so that they survive a loss of power, on a thread of its own: a slow disk
/// does not hold up whoever writes.
class DiskSync {
public:
    DiskSync() = default;
    ~DiskSync();
    DiskSync(const DiskSync&) = delete;
    DiskSync& operator=(const DiskSync&) = delete;

    /// What the open file holds now. While the disk is busy several wishes for a file become one.
    void file(int descriptor);
    /// The names in the folder.
    void folder(const std::string& path);
    /// Waits until all of it is done. The first failure since the beginning.
    Outcome finish();

private:
    void add(int descriptor);
    void run();

    std::mutex _mutex;
    std::condition_variable _changed;
    std::vector<int> _wanted; // duplicates of descriptors
    bool _isBusy = false;
    bool _isEnding = false;
    std::optional<Failure> _failure;
    std::thread _thread; // from the first wish on
};

} // namespace spectrel
