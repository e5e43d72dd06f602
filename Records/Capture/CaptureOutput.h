#pragma once

#include "Values/Result.h"

#include <cstdio>
#include <string>

namespace spectrel {

/// The file that a capture is written to: whoever is killed, at whatever time, leaves one that can be read.
///
/// A new file is made under a hidden name and gets its own when its head stands in it; a file that is overwritten
/// has a head throughout.
class CaptureOutput {
public:
    enum class IfThere { Overwrite, Refuse };

    /// Opens the output; "-" is standard output.
    static Result<CaptureOutput> open(const std::string& path, IfThere ifThere);
    CaptureOutput(CaptureOutput&& other) noexcept;
    CaptureOutput(const CaptureOutput&) = delete;
    CaptureOutput& operator=(const CaptureOutput&) = delete;
    /// Removes a file that was not published. The stream is not closed.
    ~CaptureOutput();

    /// The caller closes it.
    std::FILE* stream() const
    {
        return _stream;
    }
    /// To be called when the head has been written. Fails with `Exists` when a file of the name is there and must stay.
    Outcome publish();

private:
    CaptureOutput(std::FILE* stream, std::string path, std::string hidden, IfThere ifThere);

    std::FILE* _stream;
    std::string _path;
    std::string _hidden; // the name until it is published; empty when it has its own
    IfThere _ifThere;
};

} // namespace spectrel
