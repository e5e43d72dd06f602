#pragma once

#include "Platform/Qt/QtRunLoop.h"
#include "Platform/Sockets/SocketMessagePorts.h"
#include "Tests/Fakes/LogRecorder.h"
#include "Tests/Fakes/ScratchFolder.h"

#include <chrono>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// Real ports in a folder of the test's own. Limits are for failures only; nothing waits for them otherwise.
class PortFixture : public testing::Test {
protected:
    static constexpr std::chrono::seconds Limit {60};
    static constexpr std::chrono::seconds Second {1};
    static constexpr std::chrono::nanoseconds AtOnce {0};
    static constexpr const char* Name = "org.spectrel.Test";

    static ByteView bytes(std::string_view text)
    {
        return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
    }
    static std::string text(ByteView body)
    {
        return {body.begin(), body.end()};
    }
    /// A handler that keeps what comes, as "ID:BODY", and answers nothing.
    LocalMessagePort::MessageHandler keeping()
    {
        return [this](std::int32_t id, ByteView body) {
            received.push_back(std::to_string(id) + ":" + text(body));
            return std::nullopt;
        };
    }
    std::shared_ptr<LocalMessagePort> serve(LocalMessagePort::MessageHandler handler)
    {
        auto port = ports.createLocal(Name, std::move(handler)).port;
        if (port)
            port->serve();
        return port;
    }
    SendStatus send(RemoteMessagePort& port, std::int32_t id, std::string_view body)
    {
        return port.sendRequest(id, bytes(body), Second, AtOnce, ReplyMode::None, nullptr);
    }
    SendStatus ask(RemoteMessagePort& port, std::string_view body, std::optional<Bytes>& reply,
        std::chrono::nanoseconds timeout = Limit)
    {
        return port.sendRequest(7, bytes(body), Second, timeout, ReplyMode::Wait, &reply);
    }
    bool turnUntil(const std::function<bool()>& done)
    {
        return loop.runUntil(done, Limit);
    }
    bool turnUntilReceived(std::size_t count)
    {
        return turnUntil([this, count] { return received.size() >= count; });
    }

    LogRecorder log;
    ScratchFolder folder;
    QtRunLoop loop;
    SocketMessagePorts ports {folder.path().string(), log};
    SocketMessagePorts elsewhere {
        folder.path().string(), log}; // shares no table with `ports`, as another process's would
    std::vector<std::string> received;
};

} // namespace spectrel
