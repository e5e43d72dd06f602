#include "Platform/Sockets/OpenStreamInput.h"

#include "Platform/Sockets/ListeningInput.h"
#include "Platform/Sockets/PipeInput.h"

#include <string_view>

namespace spectrel {

namespace {

constexpr std::string_view UnixPrefix = "unix:";
constexpr std::string_view TCPPrefix = "tcp:";

std::unique_ptr<StreamInput> openByKind(const std::string& address, std::string& reason)
{
    if (address.starts_with(UnixPrefix))
        return ListeningInput::openUnix(address.substr(UnixPrefix.size()), reason);
    if (address.starts_with(TCPPrefix))
        return ListeningInput::openTCP(address.substr(TCPPrefix.size()), reason);
    return PipeInput::open(address, reason);
}

} // namespace

std::unique_ptr<StreamInput> openStreamInput(const std::string& address, std::string& reason)
{
    auto input = openByKind(address, reason);
    if (!input)
        reason = (address == "-" ? "standard input" : address) + ": " + reason;
    return input;
}

} // namespace spectrel
