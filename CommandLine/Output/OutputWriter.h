#pragma once

#include "CommandLine/Output/DisplayChanges.h"
#include "Monitor/Journal.h"
#include "Platform/Clock.h"
#include "Values/Value.h"

#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>
#include <string_view>

namespace spectrel {

enum class OutputFormat : std::uint8_t { Tree, Json, Changes, Csv, Events, None };

/// "tree", "json", "changes", "csv", "events", "none".
std::optional<OutputFormat> outputFormatNamed(std::string_view name);

/// Whether displays are printed as their changes.
constexpr bool printsChanges(OutputFormat format)
{
    return format == OutputFormat::Changes || format == OutputFormat::Csv;
}

/// Prints displays in one format to a stream, in large writes.
class OutputWriter {
public:
    /// Csv begins with its header at once.
    OutputWriter(std::FILE* stream, OutputFormat format);

    /// The whole display: a tree, or JSON on one line. Nothing for the other formats.
    void printDisplay(const Value& display);
    /// {"n": N, "display": ...} on one line.
    void printNumberedJson(std::uint64_t n, const Value& display);
    /// What has changed since the last call, in Changes or Csv form; the journal follows the display.
    void printChanges(std::uint64_t n, Moment time, const Value& display, Journal& journal);
    void printLine(std::string_view line);
    /// Writes out what has gathered. False once the stream has failed (a full disk, a closed pipe).
    bool flush();

private:
    void flushWhenLarge();

    std::FILE* _stream;
    OutputFormat _format;
    std::string _gathered;
    DisplayChanges _changes;
    bool _hasFailed = false;
};

} // namespace spectrel
