#pragma once

#include "Values/Bytes.h"
#include "Values/OwnFile.h"
#include "Values/Result.h"

#include <string>
#include <sys/types.h>

namespace spectrel {

/// The file that a capture is written to: whoever is killed, at whatever time, leaves one that can be read.
///
/// A new file is made under a hidden name and gets its own when its head stands in it; a file that is overwritten
/// has a head throughout. Nobody else's file is touched, see `openOwnFile`. While it is open a file is locked
/// (flock), by which others know that it is being written.
class CaptureOutput {
public:
    /// Opens the output; "-" is standard output. Fails with `Refused` when another program is writing the file.
    static Result<CaptureOutput> open(const std::string& path, IfThere ifThere);
    CaptureOutput(CaptureOutput&& other) noexcept;
    CaptureOutput(const CaptureOutput&) = delete;
    CaptureOutput& operator=(const CaptureOutput&) = delete;
    /// Closes the file, and removes one that was not published.
    ~CaptureOutput();

    /// To be called when the head has been written. Fails with `Exists` when a file of the name is there and must stay.
    Outcome publish();
    /// Writes all of it or, as far as the file can be cut, nothing.
    Outcome append(ByteView bytes);
    int descriptor() const
    {
        return _file;
    }

private:
    CaptureOutput(int file, std::string path, std::string hidden);

    int _file;
    off_t _length = 0; // of what was appended
    std::string _path;
    std::string _hidden; // the name until it is published; empty when it has its own
};

} // namespace spectrel
