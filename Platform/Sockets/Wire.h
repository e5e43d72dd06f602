#pragma once

#include "Platform/MessagePort.h"
#include "Values/Bytes.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>

namespace spectrel::wire {

/// What a packet is. One-way messages and requests travel to the port's owner, replies back.
enum class Kind : std::uint8_t { OneWay = 1, Request = 2, Reply = 3 };

/// The start of every packet: 12 bytes, little-endian.
///
///   offset 0, 1 byte   0x53, the mark of this protocol
///          1, 1 byte   kind
///          2, 2 bytes  0
///          4, 4 bytes  message id, signed; a reply repeats its request's
///          8, 4 bytes  sequence number, unsigned; a reply repeats its request's, a one-way message has any
///
/// The body follows, to the packet's end: 1 byte to 256 KiB; a reply's may also be empty.
struct Header {
    Kind kind = Kind::OneWay;
    std::int32_t id = 0;
    std::uint32_t sequence = 0;
};

constexpr std::size_t HeaderLength = 12;
constexpr std::size_t LargestPacket = HeaderLength + LargestMessage;
/// What SO_SNDBUF is set to: the largest value that default system limits grant, and enough for the largest packet.
constexpr int SendBuffer = 212'992;

struct Packet {
    Header header;
    ByteView body;
};

/// Writes into `bytes`.
void encode(const Header& header, std::array<std::uint8_t, HeaderLength>& bytes);
/// None when the bytes are no packet of this protocol.
std::optional<Packet> decode(ByteView bytes);

/// Room for the largest packet; memory that no packet reaches is never touched.
class Buffer {
public:
    std::uint8_t* bytes();

private:
    std::unique_ptr<std::uint8_t[]> _bytes;
};

/// How one system call on a socket ended.
enum class Outcome : std::uint8_t { Done, WouldBlock, Closed, Failed };

/// Sends a packet without waiting, and without SIGPIPE.
Outcome send(int socket, const Header& header, ByteView body);
/// Takes one packet without waiting. `packet` is what came, cut at the largest packet's length; `length` is its whole
/// length.
Outcome receive(int socket, Buffer& buffer, ByteView& packet, std::size_t& length);

/// Whether the process at the other end is of this user.
bool isPeerOfThisUser(int socket);

} // namespace spectrel::wire
