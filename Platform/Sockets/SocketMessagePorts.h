#pragma once

#include "Platform/MessagePort.h"
#include "Platform/Sockets/FileDescriptor.h"
#include "Platform/SystemLog.h"
#include "Values/Result.h"

#include <map>
#include <memory>
#include <string>
#include <string_view>

namespace spectrel {

/// Message ports as Unix sockets of sequential packets in one private folder, a file a name; docs/message-ports.md
/// tells the whole transport. Ports need the run loop's application object before they are made.
class SocketMessagePorts final : public MessagePorts {
public:
    /// Nothing is made or checked yet.
    SocketMessagePorts(std::string directory, SystemLog& log);
    /// Makes the folder at need. Fails when it cannot be had or a port of that name would not fit.
    static Outcome prepareDirectory(const std::string& directory, std::string_view name);

    /// Makes the folder at need. Null and logged when it belongs to somebody else or the name cannot be used.
    LocalResult createLocal(std::string_view name, LocalMessagePort::MessageHandler handler) override;
    /// Gives the listening socket of a name that was made elsewhere: `createLocal` of the name serves it. Fails when
    /// it does not listen where the name is looked for.
    Outcome adopt(std::string_view name, FileDescriptor socket);
    /// Null when nobody, or another user, serves the name.
    std::shared_ptr<RemoteMessagePort> createRemote(std::string_view name) override;

private:
    std::string _directory;
    SystemLog& _log;
    std::map<std::string, std::weak_ptr<LocalMessagePort>, std::less<>> _locals; // of this process
    std::map<std::string, FileDescriptor, std::less<>> _adopted; // until they are served
};

} // namespace spectrel
