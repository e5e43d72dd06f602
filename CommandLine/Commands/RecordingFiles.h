#pragma once

#include "Platform/Clock.h"
#include "Records/Recording.h"
#include "Values/Result.h"

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace spectrel {

/// Where a session is recorded, and when a further file begins.
struct RecordingFilesOptions {
    /// A capture file, "-" (standard output), or a folder: one that is there, or a name that ends with a slash.
    std::string target;
    std::optional<std::uint64_t> largestFile; // bytes
    std::optional<std::chrono::milliseconds> longestFile; // of time
    std::optional<std::uint64_t> keep; // of the numbered files, the latest
    bool overwrite = false; // a capture file that is there
};

/// The capture files of one recorded session.
///
/// A file FILE.pcap is followed by FILE-2.pcap, FILE-3.pcap and so on: the first is new, or overwritten where that is
/// asked for, the others take numbers that are free. In a folder the files are numbered on from those that are there:
/// "spectrel-000001-lte.pcap". A file begins with the first message, when it is full or its time is over, and when the
/// technology changes. Files that are being written, here or by another recorder, are never removed.
class RecordingFiles {
public:
    /// The clock outlives this; messages have its time.
    RecordingFiles(RecordingFilesOptions options, const Clock& clock);

    // Failures name the file.
    /// Makes the folder at need. Fails when there is no place to write.
    Outcome prepare();
    /// Begins the first file, so that it is there before the first message.
    Outcome begin(Technology technology);
    Outcome write(Technology technology, ByteView message);
    Outcome flush();

    /// A file's name as messages tell it; "-" is standard output.
    static std::string spoken(const std::string& path);
    /// The current file; empty before the first.
    const std::string& path() const
    {
        return _path;
    }
    std::size_t count() const
    {
        return _count;
    }

private:
    bool isFull(std::size_t message) const;
    Outcome beginNext(Technology technology);
    Outcome createNext(Technology technology);
    std::string numberedPath(Technology technology) const;
    Result<std::uint64_t> nextNumber() const;
    Outcome checkTarget() const;
    void removeOldest();

    RecordingFilesOptions _options;
    const Clock& _clock;
    bool _isFolder = false;
    std::uint64_t _number = 0; // of the latest file
    std::unique_ptr<RecordingWriter> _writer;
    Technology _technology = Technology::LTE;
    std::string _path;
    std::size_t _count = 0; // of files begun
    std::uint64_t _bytes = 0; // of the current file
    std::chrono::nanoseconds _begun {0}; // steady: the current file
    std::vector<std::string> _written; // outside of folders: the files begun, oldest first
};

} // namespace spectrel
