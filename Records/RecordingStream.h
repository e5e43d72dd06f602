#pragma once

#include "Records/Recording.h"
#include "Values/Bytes.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace spectrel {

/// What a stream of recording bytes yields next.
enum class StreamStep : std::uint8_t {
    Waiting, // nothing before more bytes come
    Begin, // a recording starts: `technology` holds for what follows
    Message,
    Skipped, // `skipped` says what
    Refused, // `reason` says why nothing of this stream can be used; final
};

/// Bytes of a stream that were no message.
struct SkippedBytes {
    std::uint64_t offset = 0; // from the stream's first byte
    std::uint64_t length = 0;
    std::string reason;
};

/// Cuts a live stream of capture (classic pcap) or DLF bytes into log messages as they come, and finds its way on after
/// damage. Several recordings may follow each other. The first bytes decide the kind; docs/sources.md has the rules.
///
/// Take steps until `Waiting` after each `append`; then what is kept stays below `MostPending` bytes. Where the bytes
/// are cut apart on their way makes no difference, unless `settle` is called.
class RecordingStream {
public:
    static constexpr std::size_t LargestAppend = 64 * 1024;
    static constexpr std::size_t MostPending = 1024 * 1024;

    virtual ~RecordingStream() = default;
    virtual void append(ByteView bytes) = 0;
    /// No more bytes have come for a moment: decides on what there is what would otherwise wait for what follows it.
    virtual void settle() = 0;
    /// No more bytes will come.
    virtual void finish() = 0;
    /// The body of a message is valid until the next call of anything here.
    virtual StreamStep next(RecordedMessage& message) = 0;

    /// None before the first `Begin`.
    virtual std::optional<Technology> technology() const = 0;
    virtual const SkippedBytes& skipped() const = 0;
    virtual const std::string& reason() const = 0;
};

/// `technology`: where the stream does not name it.
std::unique_ptr<RecordingStream> makeRecordingStream(std::optional<Technology> technology);

} // namespace spectrel
