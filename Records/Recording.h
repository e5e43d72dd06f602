#pragma once

#include "Records/Technology.h"
#include "Values/Bytes.h"
#include "Values/Moment.h"
#include "Values/Result.h"
#include "Values/Value.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// One inbound log message as it was delivered, wrapper and all.
struct RecordedMessage {
    Moment time;
    ByteView body; // valid until the next one is read
};

/// Reads a recording message by message, whatever the kind of file: a capture, a snapshot or a DLF.
class RecordingReader {
public:
    virtual ~RecordingReader() = default;
    /// None when the file does not name it.
    virtual std::optional<Technology> technology() const = 0;
    /// False at the end and at damage; `damage` then says which.
    virtual bool next(RecordedMessage& message) = 0;
    /// What ended the reading early, with the place in the file ("message 12 at byte 3481: ..."); empty at a clean end.
    virtual const std::string& damage() const = 0;
    /// The whole snapshot that the messages come from; null in any other kind of file.
    virtual DictionaryRef snapshot() const
    {
        return nullptr;
    }
};

/// Opens a recording; its content says its kind. Fails when it cannot be read or is of no known kind.
Result<std::unique_ptr<RecordingReader>> openRecording(const std::string& path);

/// Writes a capture (classic pcap); the link type names the technology. What is written gathers until it is flushed, or
/// is much; only whole messages go out.
class RecordingWriter {
public:
    /// What gathers at most while there is no room for it.
    static constexpr std::size_t MostWaiting = 8 * 1024 * 1024; // bytes

    virtual ~RecordingWriter() = default;
    /// Fails where the message is not taken: a capture cannot hold it, or the writer has failed for good, or,
    /// with `NoRoom`, too much waits for room already.
    virtual Outcome write(Moment time, ByteView body) = 0;
    /// Writes out what has gathered. After a failure with `NoRoom` (a full disk) the file still ends with a whole
    /// message and what has gathered waits for the next flush; any other is final. The end of a writer tries once more.
    virtual Outcome flush() = 0;
    /// Messages taken that are not written out.
    virtual std::uint64_t waiting() const = 0;
    /// Of the file; -1 where there is none.
    virtual int descriptor() const = 0;
};

/// Makes a capture file, or overwrites one of this user's; "-" is standard output. What is there and belongs to
/// somebody else, or is a link, or is being written by another program, is refused.
///
/// A program that is killed, at whatever time, leaves a file that can be read: a new one has its head from the start,
/// and at most the last message is cut, where the kill struck in the midst of a write.
Result<std::unique_ptr<RecordingWriter>> createRecording(const std::string& path, Technology technology);
/// The same for a name that no file has yet: fails with `Exists` when one has it.
Result<std::unique_ptr<RecordingWriter>> createNewRecording(const std::string& path, Technology technology);

/// Takes bytes of a recording, all or none.
using RecordingOutput = std::function<Outcome(ByteView bytes)>;
/// A capture that goes anywhere, its head first.
Result<std::unique_ptr<RecordingWriter>> createRecordingOn(RecordingOutput output, Technology technology);

} // namespace spectrel
