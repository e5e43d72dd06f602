#pragma once

#include "Records/Technology.h"
#include "Values/Bytes.h"
#include "Values/Moment.h"
#include "Values/Result.h"
#include "Values/Value.h"

#include <cstdint>
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

/// Writes a capture file (classic pcap); the link type names the technology.
class RecordingWriter {
public:
    virtual ~RecordingWriter() = default;
    virtual Outcome write(Moment time, ByteView body) = 0;
    virtual Outcome flush() = 0;
};

/// Makes a capture file, or overwrites one; "-" is standard output.
///
/// A program that is killed, at whatever time, leaves a file that can be read: a new one has its head from the start,
/// and at most the last message is cut, where the kill struck in the midst of a write.
Result<std::unique_ptr<RecordingWriter>> createRecording(const std::string& path, Technology technology);
/// The same for a name that no file has yet: fails with `Exists` when one has it.
Result<std::unique_ptr<RecordingWriter>> createNewRecording(const std::string& path, Technology technology);

} // namespace spectrel
