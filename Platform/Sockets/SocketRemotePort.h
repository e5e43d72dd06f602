#pragma once

#include "Platform/MessagePort.h"
#include "Platform/Sockets/FileDescriptor.h"
#include "Platform/SystemLog.h"

#include <memory>
#include <string>

namespace spectrel {

/// The sending end of a port: one connection to its owner.
class SocketRemotePort final : public RemoteMessagePort {
public:
    SocketRemotePort(std::string name, FileDescriptor socket, SystemLog& log);
    ~SocketRemotePort() override;

    const std::string& name() const override;
    SendStatus sendRequest(std::int32_t id, ByteView body, std::chrono::nanoseconds sendTimeout,
        std::chrono::nanoseconds receiveTimeout, ReplyMode replyMode, std::optional<Bytes>* reply) override;
    void setInvalidationHandler(InvalidationHandler handler) override;
    void invalidate() override;
    bool isValid() const override;
    void setWritableHandler(std::function<void()> handler) override;

private:
    class Core;
    std::shared_ptr<Core> _core; // lives on while one of its handlers runs
};

} // namespace spectrel
