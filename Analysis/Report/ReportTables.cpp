#include "Analysis/Report/ReportTables.h"

#include "Analysis/Report/CellNames.h"
#include "Analysis/Report/HTMLText.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <map>
#include <numeric>
#include <string_view>

namespace spectrel {

namespace {

constexpr std::size_t MaxCellRows = 200;

void appendHead(std::string_view caption, std::initializer_list<std::string_view> columns, std::string& out)
{
    out += "<div class=\"wide\"><table><caption>" + escaped(caption) + "</caption><thead><tr>";
    for (const std::string_view column : columns)
        out += "<th scope=\"col\">" + std::string(column) + "</th>";
    out += "</tr></thead>\n<tbody>\n";
}

void appendEnd(std::string& out)
{
    out += "</tbody></table></div>\n";
}

void appendCellOf(const std::string& content, std::string& out)
{
    out += "<td>" + content + "</td>";
}

std::string textOr(const std::string& text)
{
    return text.empty() ? "–" : escaped(text);
}

std::string timeElement(Moment time)
{
    return "<time datetime=\"" + machineTimeText(time) + "\">" + clockText(time) + "</time>";
}

/// A value of each recording in a row of the overview; the row is left out where none has one.
template <typename TextOf>
void appendRow(
    std::string_view title, const std::vector<ReportedRecording>& recordings, TextOf textOf, std::string& out)
{
    const bool isKnown = std::any_of(recordings.begin(), recordings.end(),
        [&textOf](const ReportedRecording& recording) { return !textOf(recording).empty(); });
    if (!isKnown)
        return;
    out += "<tr><th scope=\"row\">" + std::string(title) + "</th>";
    for (const ReportedRecording& recording : recordings)
        appendCellOf(textOr(textOf(recording)), out);
    out += "</tr>\n";
}

std::string joined(const std::vector<std::string>& texts, std::string_view between)
{
    std::string out;
    for (const std::string& text : texts)
        out += (out.empty() ? "" : std::string(between)) + text;
    return out;
}

/// The names of a few, else the first and the last.
std::string filesText(const std::vector<std::string>& files)
{
    constexpr std::size_t Few = 4;
    return files.size() <= Few
        ? joined(files, ", ")
        : files.front() + " to " + files.back() + " (" + std::to_string(files.size()) + " files)";
}

std::size_t countOf(const ReportedRecording& recording, ReportedEvent::Mark mark)
{
    return static_cast<std::size_t>(std::count_if(recording.events.begin(), recording.events.end(),
        [mark](const ReportedEvent& event) { return event.mark == mark; }));
}

std::string shareText(double part, double whole)
{
    return whole > 0 ? decimalText(100 * part / whole, 1) + " %" : "–";
}

std::string mhzText(const std::optional<double>& mhz)
{
    return mhz ? decimalText(*mhz, 1) : "–";
}

/// Smallest, mean and largest.
std::string spreadText(const ReportedCell& cell, Level level)
{
    const Distribution& values = cell.levels[static_cast<std::size_t>(level)];
    if (values.count() == 0)
        return {};
    return std::string(levelName(level)) + " " + levelText(values.mean()) + " <small>" + levelText(values.min())
        + " to " + levelText(values.max()) + "</small>";
}

/// What was measured of a cell, in the order of the levels.
std::string levelsText(const ReportedCell& cell)
{
    std::string out;
    for (std::size_t i = 0; i < LevelCount; ++i) {
        if (const std::string spread = spreadText(cell, static_cast<Level>(i)); !spread.empty())
            out += (out.empty() ? "" : "<br>") + spread;
    }
    return out.empty() ? "–" : out;
}

void appendCellRow(const ReportedRecording& recording, std::uint32_t number, std::string& out)
{
    const ReportedCell& served = recording.cells[number];
    const Cell& cell = served.cell;
    out += "<tr><th scope=\"row\"><span class=\"swatch " + cellColour(number) + "\"></span>" + cellLetters(number)
        + "</th>";
    appendCellOf(radioTitle(cell.technology), out);
    appendCellOf(textOr(cell.operatorName.empty() ? cell.plmn : cell.operatorName + " (" + cell.plmn + ")"), out);
    appendCellOf(cellIdentityText(cell), out);
    appendCellOf(cellIdText(cell), out);
    appendCellOf(textOr(cell.band), out);
    appendCellOf(mhzText(cell.downlinkMHz), out);
    appendCellOf(cell.channel ? std::to_string(*cell.channel) : "–", out);
    appendCellOf(
        durationText(served.seconds) + " <small>" + shareText(served.seconds, recording.seconds()) + "</small>", out);
    appendCellOf(std::to_string(served.visits), out);
    appendCellOf(levelsText(served), out);
    out += "</tr>\n";
}

void appendEvidence(const ReportedEvent& event, std::string& out)
{
    if (event.evidence.empty())
        return;
    out += "<br><small>";
    for (const auto& [path, value] : event.evidence)
        out += "<code>" + escaped(path) + "</code> " + escaped(value) + "; ";
    out.resize(out.size() - 2);
    out += "</small>";
}

void appendEventRow(const ReportedEvent& event, std::string& out)
{
    out += "<tr><th scope=\"row\">" + timeElement(event.time) + "</th>";
    out += "<td class=\"k\">" + escaped(event.kind) + "</td><td>" + escaped(event.text)
        + (event.seconds ? " (" + durationText(*event.seconds) + ")" : "");
    if (!event.cause.empty()) {
        out += "<br><small><b>" + escaped(event.cause) + "</b>"
            + (event.causeText.empty() ? "" : ": " + escaped(event.causeText)) + "</small>";
    }
    appendEvidence(event, out);
    out += "</td></tr>\n";
}

void appendEventTable(
    std::string_view caption, const std::vector<ReportedEvent>& events, std::uint64_t more, std::string& out)
{
    appendHead(caption, {"time", "what", "text"}, out);
    for (const ReportedEvent& event : events)
        appendEventRow(event, out);
    appendEnd(out);
    if (more > 0) {
        out += "<p>" + std::to_string(more)
            + " more are not listed; <code>spectrel decode --format events</code> prints all.</p>\n";
    }
}

/// "ping-pong 9, hole 6".
std::string countsText(const std::vector<ReportedEvent>& events)
{
    std::map<std::string, std::size_t> counts;
    for (const ReportedEvent& event : events)
        ++counts[event.kind];
    std::string out;
    for (const auto& [kind, count] : counts)
        out += (out.empty() ? "" : ", ") + escaped(kind) + " " + std::to_string(count);
    return out;
}

} // namespace

void appendFindings(const ReportedRecording& recording, std::string& out)
{
    if (recording.findings.empty())
        out += "<p>Nothing remarkable in " + escaped(recording.title) + ".</p>\n";
    else {
        out += "<p>" + countsText(recording.findings) + "</p>\n";
        appendEventTable(recording.title, recording.findings, recording.moreFindings, out);
    }
}

void appendOverview(const std::vector<ReportedRecording>& recordings, std::string& out)
{
    using Mark = ReportedEvent::Mark;
    out += "<div class=\"wide\"><table><thead><tr><td></td>";
    for (const ReportedRecording& recording : recordings)
        out += "<th scope=\"col\">" + escaped(recording.title) + "</th>";
    out += "</tr></thead>\n<tbody>\n";
    const auto row = [&recordings, &out](
                         std::string_view title, auto textOf) { appendRow(title, recordings, textOf, out); };
    row("files", [](const ReportedRecording& it) { return filesText(it.files); });
    row("basebands", [](const ReportedRecording& it) { return joined(it.technologies, ", "); });
    row("from", [](const ReportedRecording& it) { return it.messages ? dateText(it.first) + " UTC" : ""; });
    row("to", [](const ReportedRecording& it) { return it.messages ? dateText(it.last) + " UTC" : ""; });
    row("duration", [](const ReportedRecording& it) { return it.messages ? durationText(it.seconds()) : ""; });
    row("messages", [](const ReportedRecording& it) { return std::to_string(it.messages); });
    row("lost messages",
        [](const ReportedRecording& it) { return it.lostMessages ? std::to_string(it.lostMessages) : ""; });
    row("with a serving cell", [](const ReportedRecording& it) {
        return it.seconds() > 0
            ? durationText(it.secondsWithCell) + " (" + shareText(it.secondsWithCell, it.seconds()) + ")"
            : "";
    });
    row("serving cells", [](const ReportedRecording& it) { return std::to_string(it.cells.size()); });
    row("moves", [](const ReportedRecording& it) { return std::to_string(countOf(it, Mark::Move)); });
    row("losses of service",
        [](const ReportedRecording& it) { return std::to_string(countOf(it, Mark::ServiceLost)); });
    row("findings", [](const ReportedRecording& it) { return std::to_string(it.findings.size() + it.moreFindings); });
    row("remarks", [](const ReportedRecording& it) { return joined(it.remarks, "; "); });
    appendEnd(out);
}

void appendCells(const ReportedRecording& recording, std::string& out)
{
    std::vector<std::uint32_t> order(recording.cells.size());
    std::iota(order.begin(), order.end(), 0u);
    std::stable_sort(order.begin(), order.end(), [&recording](std::uint32_t left, std::uint32_t right) {
        return recording.cells[left].seconds > recording.cells[right].seconds;
    });
    appendHead(recording.title,
        {"", "radio", "network", "cell", "id", "band", "MHz", "channel", "time", "visits", "mean levels, range"}, out);
    for (std::size_t i = 0; i < std::min(order.size(), MaxCellRows); ++i)
        appendCellRow(recording, order[i], out);
    appendEnd(out);
    if (order.size() > MaxCellRows)
        out += "<p>" + std::to_string(order.size() - MaxCellRows)
            + " cells that served for less time are not listed.</p>\n";
}

void appendEvents(const ReportedRecording& recording, std::string& out)
{
    if (recording.events.empty())
        out += "<p>No events in " + escaped(recording.title) + ".</p>\n";
    else
        appendEventTable(recording.title, recording.events, recording.moreEvents, out);
}

} // namespace spectrel
