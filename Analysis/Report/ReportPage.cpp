#include "Analysis/Report/ReportPage.h"

#include "Analysis/Report/DistributionChart.h"
#include "Analysis/Report/HTMLText.h"
#include "Analysis/Report/LevelChart.h"
#include "Analysis/Report/ReportStyle.h"
#include "Analysis/Report/ReportTables.h"

#include <algorithm>
#include <cstddef>

namespace spectrel {

namespace {

using Recordings = std::vector<ReportedRecording>;

std::string titleOf(const Recordings& recordings)
{
    std::string title;
    for (const ReportedRecording& recording : recordings)
        title += (title.empty() ? "" : ", ") + recording.title;
    return title;
}

bool hasLevel(const ReportedRecording& recording, Level level)
{
    return recording.levels[static_cast<std::size_t>(level)].count() > 0;
}

void appendTop(const Recordings& recordings, std::string& out)
{
    const std::string title = escaped(titleOf(recordings));
    out += ReportBeginning;
    out += "<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n<meta name=\"viewport\" "
           "content=\"width=device-width,initial-scale=1\">\n"
           "<meta http-equiv=\"Content-Security-Policy\" content=\"default-src 'none'; style-src 'unsafe-inline'\">\n"
           "<title>Radio report: "
        + title + "</title>\n<style>" + ReportStyle
        + "</style>\n</head>\n<body>\n<h1>Radio report</h1>\n<p class=\"soft\">" + title
        + ". Times are UTC; levels are those of the serving cell.</p>\n";
}

void appendLevels(const Recordings& recordings, std::string& out)
{
    out += "<section>\n<h2>Levels</h2>\n<p class=\"soft\">Each colour and letter is a serving cell, as in the table of "
           "cells; a pale band spans the values around the mean. Ticks below the cells: the phone moved. Triangle: "
           "bookmark or alarm. Red: without service.</p>\n";
    for (std::size_t i = 0; i < LevelCount; ++i) {
        const auto level = static_cast<Level>(i);
        if (std::none_of(recordings.begin(), recordings.end(),
                [level](const ReportedRecording& recording) { return hasLevel(recording, level); }))
            continue;
        const LevelAxis axis = levelAxis(recordings, level);
        out += "<h3>" + std::string(levelName(level)) + "</h3>\n<div class=\"side\">\n";
        for (const ReportedRecording& recording : recordings) {
            if (recordings.size() > 1)
                out += "<div><p class=\"soft\">" + escaped(recording.title) + "</p>\n";
            if (hasLevel(recording, level)) {
                const auto number = static_cast<std::size_t>(&recording - recordings.data());
                appendLevelChart(recording, level, axis, recordings.size() > 1 ? ChartWidth::Half : ChartWidth::Whole,
                    "l" + std::to_string(i) + "r" + std::to_string(number), out);
            } else {
                out += "<p>Not measured.</p>\n";
            }
            if (recordings.size() > 1)
                out += "</div>\n";
        }
        out += "</div>\n";
    }
    out += "</section>\n";
}

void appendDistributions(const Recordings& recordings, std::string& out)
{
    out += "<section>\n<h2>Distributions</h2>\n<p class=\"soft\">Which share of the values was at or below a "
           "level.</p>\n<div class=\"side pair\">\n";
    for (std::size_t i = 0; i < LevelCount; ++i) {
        const auto level = static_cast<Level>(i);
        if (std::any_of(recordings.begin(), recordings.end(),
                [level](const ReportedRecording& recording) { return hasLevel(recording, level); }))
            appendDistributionChart(recordings, level, levelAxis(recordings, level), "d" + std::to_string(i), out);
    }
    out += "</div>\n</section>\n";
}

/// A section with what each recording has of something.
void appendSection(std::string_view title, const Recordings& recordings,
    void (*append)(const ReportedRecording&, std::string&), std::string& out)
{
    out += "<section>\n<h2>" + std::string(title) + "</h2>\n";
    for (const ReportedRecording& recording : recordings)
        append(recording, out);
    out += "</section>\n";
}

} // namespace

std::string reportPage(const Recordings& recordings)
{
    std::string out;
    appendTop(recordings, out);
    appendSection("Findings", recordings, appendFindings, out);
    out += "<section>\n<h2>What was recorded</h2>\n";
    appendOverview(recordings, out);
    out += "</section>\n";
    appendLevels(recordings, out);
    appendDistributions(recordings, out);
    appendSection("Cells", recordings, appendCells, out);
    appendSection("Events", recordings, appendEvents, out);
    out += "</body>\n</html>\n";
    return out;
}

} // namespace spectrel
