#pragma once

#include "Values/JsonObject.h"
#include "Values/Moment.h"
#include "Values/Result.h"

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

/// A file of JSON Lines beside a recording: NAME.marks or NAME.gaps beside NAME.pcap. A recording whose name ends
/// otherwise has the ending behind its whole name.
inline constexpr std::string_view MarksEnding = ".marks";
inline constexpr std::string_view GapsEnding = ".gaps";
std::string pathBeside(const std::string& recording, std::string_view ending);

/// Removes what stands beside a recording: where that goes, or another takes its name.
void removeBeside(const std::string& recording);

/// Calls `read` for each line's object, which answers whether it is what the file is to hold. The answer names the file
/// and what is wrong with it (the first line that is no such object and how many there are, or why it cannot be read);
/// empty when nothing is. A file that is not there has no lines. Nothing beyond 16 MiB or 64 KiB a line is read.
std::string readBeside(const std::string& path, const std::function<bool(const JsonObject&)>& read);

/// Appends one line by a single write, so that several programs may do so at once; makes the file (mode 0600) at need.
/// Where somebody was cut off in the midst of a line, that one is ended first. Does not follow a link, and writes to
/// nothing but a file of this user.
Outcome appendBeside(const std::string& path, std::string_view line);

/// The member "time": seconds since 1970. None where there is none, or none between 1970 and the year 9999.
std::optional<Moment> timeOf(const JsonObject& object);

} // namespace spectrel
