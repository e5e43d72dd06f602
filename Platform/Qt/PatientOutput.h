#pragma once

#include "Values/Bytes.h"
#include "Values/Result.h"

#include <cstddef>
#include <cstdio>
#include <functional>
#include <memory>
#include <optional>
#include <string>

namespace spectrel {

class QtRunLoop;

/// An output that never makes the run loop wait for whoever reads it: a pipe, a terminal, a socket, a FIFO, which may
/// find its reader later. What is not taken waits in memory; whoever writes looks at `waiting` and holds back.
class PatientOutput {
public:
    /// What may wait before a writer is to hold back, in bytes.
    static constexpr std::size_t Plenty = 1024 * 1024;

    /// "-" is standard output; a path is that of a FIFO or a device of this user's.
    static Result<std::unique_ptr<PatientOutput>> open(const std::string& path);
    ~PatientOutput();
    PatientOutput(const PatientOutput&) = delete;
    PatientOutput& operator=(const PatientOutput&) = delete;

    /// Takes all of it. Fails once the output is broken (a reader that has gone, a full disk).
    Outcome write(ByteView bytes);
    std::size_t waiting() const;
    /// Why nothing more can be written.
    const std::optional<Failure>& failure() const;
    /// Called from the main queue when all that waited was taken, and when the output breaks.
    void setChangeHandler(std::function<void()> handler);
    /// A stream that writes here; it ends with this object.
    std::FILE* stream();
    /// Turns the loop until everything was taken. As soon as `isAskedToEnd` it waits a second more and no longer.
    /// Fails, with what was not taken, or with why the output broke.
    Outcome finish(QtRunLoop& runLoop, const std::function<bool()>& isAskedToEnd);

private:
    struct Private;
    explicit PatientOutput(std::unique_ptr<Private> made);
    std::unique_ptr<Private> _private;
};

} // namespace spectrel
