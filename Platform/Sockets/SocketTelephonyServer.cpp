#include "Platform/Sockets/SocketTelephonyServer.h"

#include "Platform/TelephonyProtocol.h"
#include "Values/Dictionary.h"
#include "Values/PropertyList/PropertyList.h"

#include <chrono>
#include <utility>

namespace spectrel {

namespace {

namespace Protocol = TelephonyProtocol;

constexpr std::chrono::seconds Timeout {1};

LogChannelResult failure(std::int32_t error)
{
    return {SocketTelephonyServer::TransportDomain, error, std::nullopt};
}

LogChannelResult readAnswer(ByteView answer)
{
    const auto list = parsePropertyList(answer);
    const DictionaryRef dictionary = list ? list->dictionary() : nullptr;
    const auto error = dictionary ? (*dictionary)[Protocol::ErrorKey].int32() : std::nullopt;
    if (!error)
        return failure(SocketTelephonyServer::UnreadableAnswer);
    LogChannelResult result {(*dictionary)[Protocol::DomainKey].int32().value_or(0), *error, std::nullopt};
    if (const std::string* const name = (*dictionary)[Protocol::PortNameKey].string())
        result.portName = *name;
    return result;
}

class Connection final : public TelephonyServerConnection {
public:
    explicit Connection(std::shared_ptr<RemoteMessagePort> port)
        : _port(std::move(port))
    {
    }

    LogChannelResult RKServerConnectionNetworkMonitorCreateLogChannel(std::string_view localPortName) override
    {
        const auto request = serialisePropertyList(Dictionary::make({{Protocol::CreateLogChannelKey, localPortName}}));
        if (!request)
            return failure(static_cast<std::int32_t>(SendStatus::TransportError));
        const ByteView body(reinterpret_cast<const std::uint8_t*>(request->data()), request->size());
        std::optional<Bytes> answer;
        const auto status =
            _port->sendRequest(Protocol::CreateLogChannelId, body, Timeout, Timeout, ReplyMode::Wait, &answer);
        if (status != SendStatus::Success)
            return failure(static_cast<std::int32_t>(status));
        return answer ? readAnswer(*answer) : failure(SocketTelephonyServer::NoAnswer);
    }

private:
    std::shared_ptr<RemoteMessagePort> _port;
};

} // namespace

std::unique_ptr<TelephonyServerConnection> SocketTelephonyServer::RKServerConnectionCreate(NotificationHandler)
{
    auto port = _ports.createRemote(Protocol::ServicePort);
    return port ? std::make_unique<Connection>(std::move(port)) : nullptr;
}

} // namespace spectrel
