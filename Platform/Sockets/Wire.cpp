#include "Platform/Sockets/Wire.h"

#include <algorithm>
#include <cerrno>
#include <sys/socket.h>
#include <unistd.h>

namespace spectrel::wire {

namespace {

constexpr std::uint8_t Mark = 0x53;

void putU32(std::uint8_t* bytes, std::uint32_t value)
{
    for (int i = 0; i < 4; ++i)
        bytes[i] = static_cast<std::uint8_t>(value >> (8 * i));
}

std::uint32_t u32(const std::uint8_t* bytes)
{
    std::uint32_t value = 0;
    for (int i = 0; i < 4; ++i)
        value |= static_cast<std::uint32_t>(bytes[i]) << (8 * i);
    return value;
}

bool isKind(std::uint8_t byte)
{
    return byte >= static_cast<std::uint8_t>(Kind::OneWay) && byte <= static_cast<std::uint8_t>(Kind::Reply);
}

Outcome outcomeOf(int error)
{
    if (error == EAGAIN || error == EWOULDBLOCK)
        return Outcome::WouldBlock;
    return error == EPIPE || error == ECONNRESET || error == ENOTCONN ? Outcome::Closed : Outcome::Failed;
}

} // namespace

void encode(const Header& header, std::array<std::uint8_t, HeaderLength>& bytes)
{
    bytes[0] = Mark;
    bytes[1] = static_cast<std::uint8_t>(header.kind);
    bytes[2] = 0;
    bytes[3] = 0;
    putU32(&bytes[4], static_cast<std::uint32_t>(header.id));
    putU32(&bytes[8], header.sequence);
}

std::optional<Packet> decode(ByteView bytes)
{
    if (bytes.size() < HeaderLength || bytes.size() > LargestPacket)
        return std::nullopt;
    if (bytes[0] != Mark || !isKind(bytes[1]) || bytes[2] != 0 || bytes[3] != 0)
        return std::nullopt;
    const auto kind = static_cast<Kind>(bytes[1]);
    if (kind != Kind::Reply && bytes.size() == HeaderLength)
        return std::nullopt;
    const Header header {kind, static_cast<std::int32_t>(u32(&bytes[4])), u32(&bytes[8])};
    return Packet {header, bytes.subspan(HeaderLength)};
}

std::uint8_t* Buffer::bytes()
{
    if (!_bytes)
        _bytes = std::make_unique_for_overwrite<std::uint8_t[]>(LargestPacket);
    return _bytes.get();
}

Outcome send(int socket, const Header& header, ByteView body)
{
    std::array<std::uint8_t, HeaderLength> head;
    encode(header, head);
    iovec parts[] = {{head.data(), head.size()}, {const_cast<std::uint8_t*>(body.data()), body.size()}};
    msghdr message = {};
    message.msg_iov = parts;
    message.msg_iovlen = 2;
    for (;;) {
        if (::sendmsg(socket, &message, MSG_NOSIGNAL | MSG_DONTWAIT) >= 0)
            return Outcome::Done;
        if (errno != EINTR)
            return outcomeOf(errno);
    }
}

Outcome receive(int socket, Buffer& buffer, ByteView& packet, std::size_t& length)
{
    bool wasReset = false; // told once when the peer ended with data unread; what it sent before still follows
    for (;;) {
        const ssize_t count = ::recv(socket, buffer.bytes(), LargestPacket, MSG_DONTWAIT | MSG_TRUNC);
        if (count > 0) {
            length = static_cast<std::size_t>(count);
            packet = {buffer.bytes(), std::min(length, LargestPacket)};
            return Outcome::Done;
        }
        if (count == 0)
            return Outcome::Closed;
        if (errno == EINTR)
            continue;
        if (errno == ECONNRESET && !wasReset) {
            wasReset = true;
            continue;
        }
        return outcomeOf(errno);
    }
}

bool isPeerOfThisUser(int socket)
{
    ucred peer = {};
    socklen_t length = sizeof peer;
    return ::getsockopt(socket, SOL_SOCKET, SO_PEERCRED, &peer, &length) == 0 && peer.uid == ::geteuid();
}

} // namespace spectrel::wire
