#include "Platform/Sockets/OpenStreamInput.h"

#include "Platform/Sockets/ListeningInput.h"
#include "Platform/Sockets/PipeInput.h"

#include <string_view>

namespace spectrel {

namespace {

constexpr std::string_view UnixPrefix = "unix:";
constexpr std::string_view TCPPrefix = "tcp:";

Result<std::unique_ptr<StreamInput>> openByKind(const std::string& address)
{
    if (address.starts_with(UnixPrefix))
        return ListeningInput::openUnix(address.substr(UnixPrefix.size()));
    if (address.starts_with(TCPPrefix))
        return ListeningInput::openTCP(address.substr(TCPPrefix.size()));
    return PipeInput::open(address);
}

} // namespace

Result<std::unique_ptr<StreamInput>> openStreamInput(const std::string& address)
{
    auto input = openByKind(address);
    if (!input)
        return input.failure().of(address == "-" ? "standard input" : address);
    return input;
}

} // namespace spectrel
