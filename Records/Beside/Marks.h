#pragma once

#include "Values/Moment.h"
#include "Values/Result.h"

#include <cstddef>
#include <string>
#include <vector>

namespace spectrel {

/// A bookmark: what somebody noted at a moment of a recording.
struct Mark {
    Moment time {};
    std::string note;
};

/// The bookmarks of a recording NAME.pcap stand in NAME.marks beside it, JSON Lines: {"time": 1733000000.123456,
/// "note": "tunnel"}.
std::string marksPath(const std::string& recording);

struct Marks {
    std::vector<Mark> marks; // in the order of time
    std::string damage; // which file could not be read, or which line of it; empty where all is well
};
/// The bookmarks of a recording; none where there is no such file. Lines that are no bookmarks are left out.
Marks readMarks(const std::string& recording);

/// A note has at most so many bytes; the rest is cut off when it is written.
inline constexpr std::size_t LongestNote = 4096;
/// Appends a bookmark beside a recording. What is no UTF-8 in the note is replaced. Fails, naming the file, when it
/// cannot be written.
Outcome appendMark(const std::string& recording, const Mark& mark);

} // namespace spectrel
