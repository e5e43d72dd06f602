#pragma once

#include "Platform/MessagePort.h"
#include "Platform/Sockets/FileDescriptor.h"
#include "Platform/Sockets/PortName.h"
#include "Platform/SystemLog.h"

#include <memory>
#include <string>

namespace spectrel {

/// A named port on a listening socket; each sender is one connection. Its end frees the name.
class SocketLocalPort final : public LocalMessagePort {
public:
    static constexpr int LargestBatch = 64; // messages that one sender gets in before the run loop turns
    static constexpr std::size_t MostConnections = 64; // further senders are turned away

    /// `socket` listens at `path` (empty: a file that stays when the port ends); `lock` is the right to the name.
    SocketLocalPort(std::string name, std::string path, NameLock lock, FileDescriptor socket, MessageHandler handler,
        SystemLog& log);
    ~SocketLocalPort() override;

    const std::string& name() const override;
    void serve() override;
    void setPaused(bool isPaused) override;
    void setInvalidationHandler(InvalidationHandler handler) override;
    void invalidate() override;
    bool isValid() const override;

private:
    class Core;
    std::shared_ptr<Core> _core; // lives on while one of its handlers runs
};

} // namespace spectrel
