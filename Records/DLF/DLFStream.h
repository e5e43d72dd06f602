#pragma once

#include "Records/MessageCutter.h"
#include "Records/Recording.h"
#include "Records/StreamCutter.h"

#include <cstddef>
#include <deque>
#include <optional>

namespace spectrel {

/// Cuts DLF items, and messages as received, out of a stream: by the same rules as from a file, over the bytes that are
/// there. Nothing but what follows says how such bytes are to be cut, so a decision waits for a window of bytes, for
/// the stream to settle or for its end.
class DLFStream final : public StreamCutter {
public:
    static constexpr std::size_t Window = 256 * 1024; // its first half is decided on; longer than two items

    explicit DLFStream(Technology technology)
        : _technology(technology)
    {
    }
    Found next(StreamBuffer& buffer, RecordedMessage& message, Piece& damage) override;
    std::optional<Technology> technology() const override
    {
        return _technology;
    }

private:
    void plan(const StreamBuffer& buffer);
    void giveUp(const StreamBuffer& buffer, std::size_t place, std::size_t end);
    bool takeVersionReport(StreamBuffer& buffer, const MessageCutter::Cut& cut);

    Technology _technology;
    bool _hasBegun = false;
    Moment _time {}; // of writing
    std::deque<MessageCutter::Cut> _cuts; // decided on, one behind the other from the buffer's front
    std::size_t _looked = 0; // bytes that the last plan saw; fewer hold nothing new
    Bytes _restored; // a message whose first byte is not in the stream
};

} // namespace spectrel
