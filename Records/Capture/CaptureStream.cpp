#include "Records/Capture/CaptureStream.h"

#include "Records/Capture/CaptureFormat.h"
#include "Records/Frame.h"
#include "Values/Bytes.h"

#include <algorithm>
#include <array>
#include <utility>

namespace spectrel {

namespace {

/// What shows that a body is a log message.
constexpr std::size_t LongestFrame = WrapperSize + RecordTypeSize + ItemLengthSize;
constexpr std::size_t LeastEvidence = PacketHeaderSize + LongestFrame; // no place is confirmed by fewer bytes
constexpr std::uint32_t Microseconds = 0xA1B2C3D4;
constexpr std::uint32_t Nanoseconds = 0xA1B23C4D;
constexpr std::array<std::uint8_t, 8> Version {2, 0, 4, 0, 0, 0, 0, 0}; // 2.4, and no time zone

std::uint32_t swapped(std::uint32_t number)
{
    return number << 24 | (number & 0xFF00) << 8 | (number >> 8 & 0xFF00) | number >> 24;
}

bool isMagic(std::uint32_t number)
{
    return number == Microseconds || number == Nanoseconds;
}

/// Whether a capture starts there, as far as the bytes go; a packet's header cannot look so, for it would be empty.
bool startsCapture(ByteView bytes)
{
    static constexpr std::array<std::array<std::uint8_t, 4>, 4> Magics {
        {{0xD4, 0xC3, 0xB2, 0xA1}, {0xA1, 0xB2, 0xC3, 0xD4}, {0x4D, 0x3C, 0xB2, 0xA1}, {0xA1, 0xB2, 0x3C, 0x4D}}};
    static constexpr std::array<std::uint8_t, 8> SwappedVersion {0, 2, 0, 4, 0, 0, 0, 0};
    const std::size_t count = std::min<std::size_t>(bytes.size(), 4);
    const ByteView rest = bytes.subspan(count, std::min<std::size_t>(bytes.size() - count, Version.size()));
    return std::ranges::any_of(Magics, [&](const auto& magic) {
        const auto& version = magic[0] == 0xA1 ? SwappedVersion : Version;
        return std::equal(bytes.begin(), bytes.begin() + static_cast<std::ptrdiff_t>(count), magic.begin())
            && std::equal(rest.begin(), rest.end(), version.begin());
    });
}

} // namespace

std::uint32_t CaptureStream::u32(ByteView bytes, std::size_t place) const
{
    const std::uint32_t number = RecordView(bytes).u32(place);
    return _isSwapped ? swapped(number) : number;
}

CaptureStream::PacketHeader CaptureStream::headerAt(ByteView bytes, std::size_t place) const
{
    return {u32(bytes, place), u32(bytes, place + 4), u32(bytes, place + 8), u32(bytes, place + 12)};
}

/// A packet captured in part, and an empty one, are believed only where a packet must start.
bool CaptureStream::canBeTrue(const PacketHeader& header, bool isInStep) const
{
    if (header.fraction >= (_hasNanoseconds ? 1'000'000'000u : 1'000'000u) || header.captured > LargestMessage)
        return false;
    return isInStep ? header.captured <= header.length : header.captured == header.length && header.captured > 0;
}

/// Whether the body's first bytes are the frame of a log message of this length, or a property list.
bool CaptureStream::isLogMessage(ByteView body, std::size_t length) const
{
    if (_technology == Technology::IFX)
        return body[0] == '<' && body[1] == '?' && body[2] == 'x' && body[3] == 'm' && body[4] == 'l';
    const RecordView bytes(body);
    const std::size_t type = recordPlace(bytes, 0);
    const std::size_t item = type + RecordTypeSize;
    return isRecordType(bytes.u8(type)) && item + itemLength(bytes, item) == length;
}

CaptureStream::Verdict CaptureStream::judge(const StreamBuffer& buffer, std::size_t place) const
{
    const ByteView bytes = buffer.bytes();
    if (startsCapture(bytes.subspan(place))) {
        const std::size_t end = place + CaptureHeaderSize;
        return {place, bytes.size() < end ? Start::Possible : Start::Capture, end};
    }
    const std::size_t body = place + PacketHeaderSize;
    if (bytes.size() < body)
        return {place, Start::Possible, body};
    const PacketHeader header = headerAt(bytes, place);
    if (!canBeTrue(header, _isInStep && place == 0))
        return {};
    if (header.captured == header.length && header.captured >= LongestFrame) {
        if (bytes.size() < body + LongestFrame)
            return {place, Start::Possible, body + LongestFrame};
        if (isLogMessage(bytes.subspan(body, LongestFrame), header.captured))
            return {place, Start::Packet, body + LongestFrame};
    }
    return judgeWhatFollows(buffer, place, body + header.captured);
}

/// A packet whose body says nothing of it is confirmed by what stands at its end.
CaptureStream::Verdict CaptureStream::judgeWhatFollows(
    const StreamBuffer& buffer, std::size_t place, std::size_t end) const
{
    const ByteView bytes = buffer.bytes();
    if (bytes.size() == end && (buffer.isFinished || (buffer.isSettled && _isInStep && place == 0)))
        return {place, Start::Packet, end};
    const std::size_t needed = end + PacketHeaderSize;
    if (bytes.size() < needed)
        return {place, buffer.isFinished ? Start::Unlikely : Start::Possible, needed};
    const bool follows = startsCapture(bytes.subspan(end)) || canBeTrue(headerAt(bytes, end), false);
    return {place, follows ? Start::Packet : Start::Unlikely, needed};
}

/// The place that the earliest byte confirms. Places without a chance are judged once.
std::optional<CaptureStream::Verdict> CaptureStream::findStart(const StreamBuffer& buffer)
{
    const std::size_t size = buffer.bytes().size();
    std::optional<Verdict> best;
    std::vector<Verdict> possible;
    const auto add = [&](const Verdict& verdict) {
        if (verdict.start == Start::Possible)
            possible.push_back(verdict);
        else if (verdict.start != Start::Unlikely && (!best || verdict.needed < best->needed))
            best = verdict;
    };
    const bool asksAll = buffer.isFinished || buffer.isSettled;
    for (const Verdict& earlier : std::exchange(_possible, {}))
        add(asksAll || earlier.needed <= size ? judge(buffer, earlier.place) : earlier);
    for (; _judged < size && (!best || _judged + LeastEvidence <= best->needed); ++_judged)
        add(judge(buffer, _judged));
    _possible = std::move(possible);
    return best;
}

StreamCutter::Found CaptureStream::next(StreamBuffer& buffer, RecordedMessage& message, Piece& damage)
{
    if (buffer.bytes().empty())
        return Found::Nothing;
    const auto start = findStart(buffer);
    if (start && start->place == 0)
        return start->start == Start::Capture ? takeHeader(buffer) : takePacket(buffer, message, damage);
    if (!start && buffer.isFinished && _isInStep)
        return skipPacket(buffer, buffer.bytes().size(), "the stream ended within a packet", damage);
    std::size_t hopeless = buffer.bytes().size();
    if (start) {
        hopeless = start->place;
        _judged = 0; // the start that was found is found again
        _possible.clear();
    } else if (!buffer.isFinished && !_possible.empty()) {
        hopeless = _possible.front().place;
    }
    return hopeless == 0 ? Found::Nothing : skipDamage(buffer, hopeless, damage);
}

StreamCutter::Found CaptureStream::takePacket(StreamBuffer& buffer, RecordedMessage& message, Piece& damage)
{
    const ByteView bytes = buffer.bytes();
    const PacketHeader header = headerAt(bytes, 0);
    const std::size_t end = PacketHeaderSize + header.captured;
    if (bytes.size() < end && buffer.isFinished)
        return skipPacket(buffer, bytes.size(), "the stream ended within a packet", damage);
    if (bytes.size() < end) {
        _judged = 0; // judged again when the rest has come
        _possible.clear();
        return Found::Nothing;
    }
    if (header.captured == 0)
        return skipPacket(buffer, end, "a packet without bytes", damage);
    if (header.captured < header.length)
        return skipPacket(buffer, end, "a packet that was captured only in part", damage);
    const std::int64_t fraction = _hasNanoseconds ? header.fraction / 1000 : header.fraction;
    message.time = Moment(std::chrono::seconds(header.seconds) + std::chrono::microseconds(fraction));
    message.body = bytes.subspan(PacketHeaderSize, header.captured);
    take(buffer, end);
    return Found::Message;
}

StreamCutter::Found CaptureStream::takeHeader(StreamBuffer& buffer)
{
    const ByteView bytes = buffer.bytes();
    const std::uint32_t magic = RecordView(bytes).u32(0);
    _isSwapped = !isMagic(magic);
    _hasNanoseconds = (_isSwapped ? swapped(magic) : magic) == Nanoseconds;
    const int linkType = static_cast<int>(u32(bytes, 20) & 0x0FFFFFFF); // the rest is about check sums
    const auto told = technologyOfLinkType(linkType);
    _technology = told ? told : _fallback;
    take(buffer, CaptureHeaderSize);
    return Found::Begin;
}

StreamCutter::Found CaptureStream::skipPacket(
    StreamBuffer& buffer, std::size_t count, const char* reason, Piece& damage)
{
    take(buffer, count);
    damage = {count, reason};
    return Found::Damage;
}

/// What was found out about the bytes behind the damage stays known.
StreamCutter::Found CaptureStream::skipDamage(StreamBuffer& buffer, std::size_t count, Piece& damage)
{
    buffer.drop(count);
    _judged -= std::min(_judged, count);
    std::erase_if(_possible, [count](const Verdict& verdict) { return verdict.place < count; });
    for (Verdict& verdict : _possible) {
        verdict.place -= count;
        verdict.needed -= count;
    }
    if (_judged == 0)
        _possible.clear();
    _isInStep = false;
    damage = {count, "no packet starts there"};
    return Found::Damage;
}

void CaptureStream::take(StreamBuffer& buffer, std::size_t count)
{
    buffer.drop(count);
    _judged = 0;
    _possible.clear();
    _isInStep = true;
}

} // namespace spectrel
