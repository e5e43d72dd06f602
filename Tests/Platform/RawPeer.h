#pragma once

#include <cstdint>
#include <ostream>
#include <string>
#include <string_view>

namespace spectrel::raw {

/// The other end of a message port, written from docs/message-ports.md with bare system calls. Sockets are blocking;
/// -1 or an empty text means a failure.

int connectTo(const std::string& directory, std::string_view name);
int listenAt(const std::string& directory, std::string_view name);
int accept(int listening);

/// A packet: mark 0x53, kind, two zero bytes, id, sequence number, body.
std::string packet(std::uint8_t kind, std::int32_t id, std::uint32_t sequence, std::string_view body);
bool send(int socket, std::string_view bytes);
/// A packet by name, for tests over several.
struct NamedPacket {
    std::string name;
    std::string bytes;
    friend std::ostream& operator<<(std::ostream& stream, const NamedPacket& packet)
    {
        return stream << packet.name;
    }
};

/// One packet, as it came; empty at the peer's end.
std::string receive(int socket);

} // namespace spectrel::raw
