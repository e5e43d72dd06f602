#pragma once

#include "Platform/Sockets/FileDescriptor.h"
#include "Values/Result.h"

#include <optional>
#include <string>

namespace spectrel {

/// The system's service manager, as far as it has started this process: systemd's notification datagrams and its socket
/// activation, or anything that speaks the same. Takes what it was told out of the environment, so that no child finds
/// it.
class ServiceManager {
public:
    ServiceManager();

    /// Whether it wants to be notified.
    bool isListening() const
    {
        return !_address.empty();
    }
    /// Sends such as "READY=1\nSTATUS=two clients"; nothing without a listener. Never waits.
    void notify(const std::string& state) const;
    /// The listening socket of sequential packets that was passed on; empty when nothing was. Fails when something else
    /// was.
    Result<FileDescriptor> takeListeningSocket();

private:
    std::string _address; // of the notification socket; an abstract one starts with "@"
    int _passedDescriptors = 0;
};

} // namespace spectrel
