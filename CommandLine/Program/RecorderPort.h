#pragma once

#include "Platform/MessagePort.h"
#include "Values/Result.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// Where a running recorder takes bookmarks: a message port of its own, named after the job and the process.
/// docs/message-ports.md has its protocol. Only the recorder writes the bookmarks, for it alone knows which file it is
/// at.
class RecorderPort {
public:
    static constexpr std::string_view NamePrefix = "org.spectrel.Record.";
    static constexpr std::string_view NameEnding = ".Marks";

    /// What a recorder is asked for. Both answer the recording's path, or why there is none.
    struct Handlers {
        std::function<Result<std::string>()> recording; // that is being written
        std::function<Result<std::string>(const std::string& note)> mark; // writes a bookmark beside it
    };

    /// Without a port, which another may hold, nobody ever asks.
    RecorderPort(MessagePorts& ports, const std::string& portPrefix, Handlers handlers);
    ~RecorderPort();
    RecorderPort(const RecorderPort&) = delete;
    RecorderPort& operator=(const RecorderPort&) = delete;

private:
    std::shared_ptr<LocalMessagePort> _port;
};

/// Has the one recorder that serves any of the ports write a bookmark; answers the recording's path. Fails when there
/// is no recorder or several, and when it has no file.
Result<std::string> markRunningRecording(
    MessagePorts& ports, const std::vector<std::string>& names, const std::string& note);

} // namespace spectrel
