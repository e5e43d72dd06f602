#pragma once

#include "Records/Recording.h"
#include "Records/StreamCutter.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace spectrel {

/// Cuts classic captures, in either byte order, with micro- or nanoseconds; one may follow the other.
///
/// Nothing in a capture marks where a packet starts. A place is taken for a packet's start when its header can be true
/// and something confirms it: the body is a log message whose length fits, or another packet, another capture or the
/// stream's end follows it. Of all places that may be one, the one that is confirmed by the earliest byte is taken: an
/// undamaged packet at once, and after damage a packet as soon as it is sure.
class CaptureStream final : public StreamCutter {
public:
    /// `technology`: where the link type names none.
    explicit CaptureStream(std::optional<Technology> technology)
        : _fallback(technology)
    {
    }
    Found next(StreamBuffer& buffer, RecordedMessage& message, Piece& damage) override;
    std::optional<Technology> technology() const override
    {
        return _technology;
    }

private:
    enum class Start : std::uint8_t { Unlikely, Possible, Packet, Capture };
    /// What a place may be the start of, and how many of the pending bytes it takes to know.
    struct Verdict {
        std::size_t place = 0;
        Start start = Start::Unlikely;
        std::size_t needed = 0;
    };
    struct PacketHeader {
        std::uint32_t seconds;
        std::uint32_t fraction;
        std::uint32_t captured;
        std::uint32_t length;
    };

    std::uint32_t u32(ByteView bytes, std::size_t place) const;
    PacketHeader headerAt(ByteView bytes, std::size_t place) const;
    bool canBeTrue(const PacketHeader& header, bool isInStep) const;
    bool isLogMessage(ByteView body, std::size_t length) const;
    Verdict judge(const StreamBuffer& buffer, std::size_t place) const;
    Verdict judgeWhatFollows(const StreamBuffer& buffer, std::size_t place, std::size_t end) const;
    std::optional<Verdict> findStart(const StreamBuffer& buffer);
    Found takePacket(StreamBuffer& buffer, RecordedMessage& message, Piece& damage);
    Found takeHeader(StreamBuffer& buffer);
    Found skipPacket(StreamBuffer& buffer, std::size_t count, const char* reason, Piece& damage);
    Found skipDamage(StreamBuffer& buffer, std::size_t count, Piece& damage);
    void take(StreamBuffer& buffer, std::size_t count);

    std::optional<Technology> _fallback;
    std::optional<Technology> _technology;
    bool _isSwapped = false; // the numbers' high byte comes first
    bool _hasNanoseconds = false;
    std::size_t _judged = 0; // so many places from the first pending byte on
    std::vector<Verdict> _possible; // of these, those that bytes to come may confirm; ascending
    bool _isInStep = true; // what was taken last ends where a packet must start
};

} // namespace spectrel
