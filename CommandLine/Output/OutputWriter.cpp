#include "CommandLine/Output/OutputWriter.h"

#include "CommandLine/Output/CsvField.h"
#include "CommandLine/Output/DisplayPrinter.h"
#include "Values/JsonText.h"
#include "Values/Moment.h"
#include "Values/Table.h"

#include <array>

namespace spectrel {

namespace {

constexpr std::size_t WriteSize = 64 * 1024;

bool isCsv(OutputFormat format)
{
    return format == OutputFormat::Csv || format == OutputFormat::Table;
}

std::string lineStart(const OutputOptions& options)
{
    std::string start = isCsv(options.format) ? "" : "{";
    if (options.file.empty())
        return start;
    if (isCsv(options.format)) {
        appendCsvField(options.file, start);
        return start + ',';
    }
    start += "\"file\": ";
    appendJsonText(options.file, start);
    return start + ", ";
}

} // namespace

std::optional<OutputFormat> outputFormatNamed(std::string_view name)
{
    struct NamedFormat {
        std::string_view name;
        OutputFormat format;
    };
    static constexpr std::array<NamedFormat, 9> Formats {{
        {"tree", OutputFormat::Tree},
        {"json", OutputFormat::Json},
        {"changes", OutputFormat::Changes},
        {"csv", OutputFormat::Csv},
        {"table", OutputFormat::Table},
        {"cells", OutputFormat::Cells},
        {"summary", OutputFormat::Summary},
        {"events", OutputFormat::Events},
        {"none", OutputFormat::None},
    }};
    const auto* known = findRow(Formats, name, &NamedFormat::name);
    return known ? std::optional(known->format) : std::nullopt;
}

OutputWriter::OutputWriter(std::FILE* stream, const OutputOptions& options)
    : _stream(stream)
    , _options(options)
    , _format(options.format)
    , _paths(options.paths)
    , _lineStart(lineStart(options))
    , _changes(_paths)
{
    if (_format == OutputFormat::Csv && options.hasHeader)
        _gathered += _options.file.empty() ? "n,time,path,value\r\n" : "file,n,time,path,value\r\n";
}

void OutputWriter::printDisplay(const Value& display)
{
    const bool isNamed = !_options.file.empty();
    if (_format == OutputFormat::Tree) {
        if (isNamed)
            _gathered += "==> " + _options.file + " <==\n";
        appendTree(display, _gathered, _paths);
    } else if (_format == OutputFormat::Json) {
        if (isNamed)
            _gathered += _lineStart + "\"display\": ";
        appendJson(display, _gathered, _paths);
        _gathered += isNamed ? "}\n" : "\n";
    }
    flushWhenLarge();
}

void OutputWriter::printNumberedJson(std::uint64_t n, const Value& display)
{
    _gathered += _lineStart + "\"n\": " + std::to_string(n) + ", \"display\": ";
    appendJson(display, _gathered, _paths);
    _gathered += "}\n";
    flushWhenLarge();
}

void OutputWriter::printChanges(std::uint64_t n, Moment time, const Value& display, Journal& journal)
{
    std::string stamp; // what each line of the message begins with
    _changes.update(display, journal, [&](const std::string& path, const std::string* value) {
        if (_format == OutputFormat::Csv) {
            if (stamp.empty())
                stamp = _lineStart + std::to_string(n) + "," + timeText(time, _options.time) + ",";
            _gathered += stamp;
            appendCsvField(path, _gathered);
            _gathered += ',';
            appendCsvField(value ? std::string_view(*value) : std::string_view(), _gathered);
            _gathered += "\r\n";
            return;
        }
        if (stamp.empty())
            stamp = _lineStart + "\"n\": " + std::to_string(n) + ", \"time\": " + jsonTimeText(time, _options.time)
                + ", \"path\": ";
        _gathered += stamp;
        appendJsonText(path, _gathered);
        _gathered += ", \"value\": ";
        if (value)
            appendJsonText(*value, _gathered);
        else
            _gathered += "null";
        _gathered += "}\n";
    });
    flushWhenLarge();
}

void OutputWriter::printLine(std::string_view line)
{
    if (!_options.file.empty() && line.starts_with('{')) {
        _gathered += _lineStart;
        line.remove_prefix(1);
    }
    _gathered += line;
    _gathered += '\n';
    flushWhenLarge();
}

void OutputWriter::flushWhenLarge()
{
    if (_gathered.size() >= WriteSize)
        flush();
}

bool OutputWriter::flush()
{
    if (std::fwrite(_gathered.data(), 1, _gathered.size(), _stream) != _gathered.size() || std::fflush(_stream) != 0)
        _hasFailed = true;
    _gathered.clear();
    return !_hasFailed;
}

} // namespace spectrel
