#pragma once

#include "Records/Recording.h"
#include "Records/StreamBuffer.h"

#include <cstdint>
#include <optional>

namespace spectrel {

/// How one kind of recording is cut out of a stream.
class StreamCutter {
public:
    enum class Found : std::uint8_t {
        Nothing, // more bytes must come
        Begin, // of a recording; its header is taken
        Message,
        Damage, // bytes that are none of it are taken; `damage` says why
    };
    struct Piece {
        std::uint64_t length = 0; // of the damage
        const char* reason = "";
    };

    virtual ~StreamCutter() = default;
    /// Takes the next piece from the buffer's front. At the stream's end everything is taken in the end.
    virtual Found next(StreamBuffer& buffer, RecordedMessage& message, Piece& damage) = 0;
    virtual std::optional<Technology> technology() const = 0;
};

} // namespace spectrel
