#pragma once

#include "Values/Bytes.h"
#include "Values/Result.h"
#include "Values/Value.h"

#include <cstddef>
#include <optional>
#include <string>

namespace spectrel {

/// What a list may hold before it "does not parse": enough for any record or template, and a wall for hostile input.
struct PropertyListLimits {
    static constexpr std::size_t Depth = 128; // containers within containers
    static constexpr std::size_t Values = 1'000'000; // shared references counted each time they are met
    static constexpr std::size_t ExpandedBytes = 64 * 1024 * 1024; // texts and data, shared ones counted each time
    static constexpr std::size_t SerialisedBytes = 256 * 1024 * 1024; // a file or message, read or written
};

/// Reads a property list in its XML or its binary form; which one, the first bytes decide.
///
/// Strict: malformed numbers, missing values, trailing garbage and unknown elements do not parse. Keys keep the
/// list's order; a key given twice keeps its last value.
std::optional<Value> parsePropertyList(ByteView bytes);

/// The same into a value that may hold an earlier list: its containers and texts are used again, as far as nobody else
/// holds them, so that lists which differ little from one to the next take no memory anew. Absent, and false, when the
/// list does not parse.
bool readPropertyList(ByteView bytes, Value& value);

/// The XML form (format code 100), UTF-8, as every reader of property lists takes it; dictionary entries in their
/// order. None when the value cannot be written: absent, deeper or larger than the limits, a text that XML cannot carry
/// (control characters, malformed UTF-8), a date outside the years 0 to 9999.
std::optional<std::string> serialisePropertyList(const Value& value);

/// Writes the XML form straight to the path, mode 0600 also where the file exists. A file that is there is overwritten
/// only where it is this user's own and no link (`openOwnFile`). One without room for the list stays as it was, one
/// that was not there is not left behind.
Outcome writePropertyListToFile(const Value& value, const std::string& path);

/// Reads a whole file as a property list; none when it cannot be read or does not parse.
std::optional<Value> readPropertyListFile(const std::string& path);

} // namespace spectrel
