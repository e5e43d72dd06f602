#pragma once

#include "CommandLine/Output/DisplayChanges.h"
#include "CommandLine/Output/TableColumns.h"
#include "CommandLine/Output/TimeForm.h"
#include "Monitor/Journal.h"
#include "Monitor/PathChoice.h"
#include "Platform/Clock.h"
#include "Values/Value.h"

#include <cstdint>
#include <cstdio>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

enum class OutputFormat : std::uint8_t { Tree, Json, Changes, Csv, Table, Cells, Summary, Events, None };

/// "tree", "json", "changes", "csv", "table", "cells", "summary", "events", "none".
std::optional<OutputFormat> outputFormatNamed(std::string_view name);

/// Whether displays are printed as their changes.
constexpr bool printsChanges(OutputFormat format)
{
    return format == OutputFormat::Changes || format == OutputFormat::Csv;
}

/// Whether what the display means is printed, at each refresh.
constexpr bool printsCells(OutputFormat format)
{
    return format == OutputFormat::Cells || format == OutputFormat::Summary;
}

/// What is printed, and how.
struct OutputOptions {
    OutputFormat format = OutputFormat::Tree;
    std::vector<std::string> paths; // globs of the leaves that Tree, Json, Changes and Csv are to show; empty: all
    std::vector<TableColumn> columns; // of Table
    std::string file; // said first on every line, and above a tree; empty: nowhere
    bool hasHeader = true; // of Csv and Table
    TimeForm time = TimeForm::Seconds;
    bool withSources = false; // with Cells: the paths that values come from
};

/// Prints displays in one format to a stream, in large writes.
class OutputWriter {
public:
    /// Csv begins with its header at once. The options outlive this.
    OutputWriter(std::FILE* stream, const OutputOptions& options);

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
    const OutputOptions& _options;
    const OutputFormat _format;
    PathChoice _paths;
    const std::string _lineStart; // of CSV; of JSON's objects, their brace included
    std::string _gathered;
    DisplayChanges _changes;
    bool _hasFailed = false;
};

} // namespace spectrel
