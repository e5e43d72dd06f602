#include "CommandLine/Program/SingleInstance.h"

#include "Values/Bytes.h"

#include <chrono>
#include <utility>

namespace spectrel {

namespace {

using namespace std::chrono_literals;

constexpr std::int32_t ActivateId = 1; // the body is "token:" and the activation token

constexpr std::string_view TokenPrefix = "token:"; // a message has at least one byte

std::string tokenFrom(ByteView body)
{
    const std::string text(body.begin(), body.end());
    return text.starts_with(TokenPrefix) ? text.substr(TokenPrefix.size()) : std::string();
}

} // namespace

SingleInstance::~SingleInstance()
{
    if (_port)
        _port->invalidate();
}

bool SingleInstance::activateOther(const std::string& activationToken)
{
    const auto other = _ports.createRemote(PortName);
    if (!other)
        return false;
    const std::string text = std::string(TokenPrefix) + activationToken;
    const Bytes body(text.begin(), text.end());
    std::optional<Bytes> reply;
    const SendStatus status = other->sendRequest(ActivateId, body, 1s, 3s, ReplyMode::Wait, &reply);
    other->invalidate();
    return status == SendStatus::Success;
}

void SingleInstance::serve(ActivationHandler handler)
{
    _port = _ports
                .createLocal(PortName,
                    [handler = std::move(handler)](std::int32_t id, ByteView body) {
                        if (id == ActivateId)
                            handler(tokenFrom(body));
                        return std::optional<Bytes>();
                    })
                .port;
    if (_port)
        _port->serve();
}

} // namespace spectrel
