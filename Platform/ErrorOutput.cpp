#include "Platform/ErrorOutput.h"

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <poll.h>
#include <string>
#include <unistd.h>

namespace spectrel {

namespace {

constexpr std::size_t PieceSize = 4096; // what a pipe that can be written takes without waiting
constexpr int PieceWait = 50; // milliseconds for a reader to take the pieces of a long line

std::uint64_t droppedLines = 0;

bool canBeWritten(int wait)
{
    pollfd output {STDERR_FILENO, POLLOUT, 0};
    return ::poll(&output, 1, wait) == 1 && (output.revents & (POLLOUT | POLLNVAL)) == POLLOUT;
}

/// False when not all of it was taken.
bool write(std::string_view text)
{
    for (int wait = 0; !text.empty(); wait = PieceWait) {
        if (!canBeWritten(wait))
            return false;
        const ssize_t written = ::write(STDERR_FILENO, text.data(), std::min(text.size(), PieceSize));
        if (written < 0 && errno != EINTR)
            return false;
        text.remove_prefix(static_cast<std::size_t>(std::max<ssize_t>(written, 0)));
    }
    return true;
}

std::string withProgram(std::string_view program, std::string_view line)
{
    std::string text(program);
    text += program.empty() ? "" : ": ";
    text += line;
    return text += '\n';
}

} // namespace

void writeErrorLine(std::string_view program, std::string_view line)
{
    if (droppedLines > 0
        && write(withProgram(program, std::to_string(droppedLines) + " lines were dropped, for nobody took them")))
        droppedLines = 0;
    if (droppedLines > 0 || !write(withProgram(program, line)))
        ++droppedLines;
}

} // namespace spectrel
